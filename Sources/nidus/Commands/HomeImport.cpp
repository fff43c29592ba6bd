#include <cstddef>
#include <memory>
#include <optional>

#include "nidus/CommandSyntax.h"
#include "nidus/Commands/Commands.h"
#include "nidus/Commands/ExitStatusText.h"
#include "nidus/Commands/HomeInput.h"
#include "nidus/InterruptionHold.h"
#include "nidus/StandardStreams.h"
#include "nidus/Terminal/Progress.h"
#include "nidus/Workspace.h"

namespace nidus {
namespace {

struct ImportOptions {
  std::string file;
  bool merges = false;
};

/// Puts the homes into the database. An interruption before they are all stored leaves it as it
/// was; one after that waits in `hold` until they are lasting and the preference suits them.
Status storeHomes(const std::vector<HomeData>& homes, bool merges, HomePlatform& platform,
                  std::optional<InterruptionHold>& hold) {
  constexpr std::size_t kManyAccessories = 500;
  const std::size_t total = accessoriesOf(homes);
  Progress progress({"Storing", total, accessoriesText(total), kManyAccessories});
  return platform.importHomes(homes, merges, [&progress, &hold, total](std::size_t stored) {
    progress.reach(stored);
    if (stored == total) hold.emplace();
  });
}

ExitStatus importHomes(const ImportOptions& options, Workspace& workspace) {
  const auto homes = readHomes(options.file);
  if (!homes) return report(homes.failure());
  const auto session = workspace.home();
  if (!session) return report(session.failure());
  std::optional<InterruptionHold> hold;
  if (auto failure = storeHomes(*homes, options.merges, (*session)->platform(), hold)) {
    return report(*failure);
  }
  return printText("imported " + sizeOf(*homes) + '\n');
}

}  // namespace

void declareHomeImport(CommandSyntax& home, Workspace& workspace) {
  const auto options = std::make_shared<ImportOptions>();
  CommandSyntax& syntax = home.command(
      "import", "Puts the homes of a document in place of all homes",
      std::string("The document is checked whole before anything is changed. Try it first with "
                  "nidus home check FILE.\n\nExample:\n  nidus home import home.json --merge") +
          kExitStatuses);
  syntax.requiredArgument("FILE", options->file, "A home document; - reads standard input");
  syntax.candidates("FILE", {{CandidateKind::files}});
  syntax.flag("--merge", options->merges,
              "Replace only the homes of the same UUID and keep the others");
  syntax.run([options, &workspace] { return importHomes(*options, workspace); });
}

}  // namespace nidus
