#include "nidus/CommandSyntax.h"
#include "nidus/Commands/Commands.h"
#include "nidus/HomeTree.h"
#include "nidus/StandardStreams.h"
#include "nidus/Workspace.h"

namespace nidus {
namespace {

ExitStatus showHomes(Workspace& workspace) {
  const auto session = workspace.home();
  if (!session) return report(session.failure());
  HomePlatform& platform = (*session)->platform();
  const auto homes = platform.exportHomes();
  if (!homes) return report(homes.failure());
  if (homes->empty()) return printText("no homes yet; import some with nidus home import FILE\n");
  const HomeWords words(platform);
  std::string text;
  for (const HomeData& home : *homes) text += homeTree(home, words);
  return printText(text);
}

}  // namespace

void declareHomeShow(CommandSyntax& home, Workspace& workspace) {
  CommandSyntax& syntax =
      home.command("show", "Shows the homes as trees of rooms, accessories, services and values",
                   "Names of types, attributes and values are those that commands use.");
  syntax.run([&workspace] { return showHomes(workspace); });
}

}  // namespace nidus
