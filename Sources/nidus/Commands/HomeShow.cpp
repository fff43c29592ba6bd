#include <memory>
#include <string>
#include <vector>

#include "nidus/CommandSyntax.h"
#include "nidus/Commands/Commands.h"
#include "nidus/Commands/ExitStatusText.h"
#include "nidus/HomeEditing/HomeObjects.h"
#include "nidus/HomeTree.h"
#include "nidus/StandardStreams.h"
#include "nidus/Workspace.h"

namespace nidus {
namespace {

/// The trees of all homes, or of the one of that name or UUID.
Result<std::string> treesOf(const std::vector<HomeData>& homes, const std::string& name,
                            const HomeWords& words) {
  const TerminalStyle style = standardOutputStyle();
  if (!name.empty()) {
    const auto index = findHome(homes, name);
    if (!index) return index.failure();
    return homeTree(homes[*index], words, style);
  }
  std::string text;
  for (const HomeData& home : homes) text += homeTree(home, words, style);
  return text;
}

ExitStatus showHomes(const std::string& name, Workspace& workspace) {
  const auto session = workspace.home();
  if (!session) return report(session.failure());
  HomePlatform& platform = (*session)->platform();
  const auto homes = platform.exportHomes();
  if (!homes) return report(homes.failure());
  if (homes->empty()) return printText("no homes yet; import some with nidus home import FILE\n");
  const auto text = treesOf(*homes, name, HomeWords(platform));
  return text ? printText(*text) : report(text.failure());
}

}  // namespace

void declareHomeShow(CommandSyntax& home, Workspace& workspace) {
  const auto name = std::make_shared<std::string>();
  CommandSyntax& syntax = home.command(
      "show", "Shows the homes as trees of rooms, accessories, services and values",
      std::string("Names of types, attributes and values are those that commands use.\n\n"
                  "Example:\n  nidus home show \"Beach House\"") +
          kExitStatuses);
  syntax.argument("HOME", *name, "The name or UUID of one home; without it all are shown");
  syntax.candidates("HOME", {{CandidateKind::homes}});
  syntax.run([name, &workspace] { return showHomes(*name, workspace); });
}

}  // namespace nidus
