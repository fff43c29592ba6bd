#include "nidus/CommandSyntax.h"
#include "nidus/Commands/Commands.h"
#include "nidus/HomeTree.h"
#include "nidus/Session.h"
#include "nidus/StandardStreams.h"

namespace nidus {
namespace {

ExitStatus showHomes(const Settings& settings) {
  const auto registered = openPlatform(settings);
  if (!registered) return report(registered.failure());
  HomePlatform& platform = *(*registered)->platform();
  const auto homes = platform.exportHomes();
  if (!homes) return report(homes.failure());
  if (homes->empty()) return printText("no homes yet; import some with nidus home import FILE\n");
  const auto metadata = platform.metadata();
  std::string text;
  for (const HomeData& home : *homes) text += homeTree(home, *metadata);
  return printText(text);
}

}  // namespace

void declareHomeShow(CommandSyntax& home, const Settings& settings) {
  CommandSyntax& syntax =
      home.command("show", "Shows the homes as trees of rooms, accessories, services and values",
                   "Names of types, attributes and values are those that commands use.");
  syntax.run([&settings] { return showHomes(settings); });
}

}  // namespace nidus
