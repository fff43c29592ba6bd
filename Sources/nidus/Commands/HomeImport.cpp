#include <memory>

#include "nidus/CommandSyntax.h"
#include "nidus/Commands/Commands.h"
#include "nidus/Commands/HomeInput.h"
#include "nidus/StandardStreams.h"
#include "nidus/Workspace.h"

namespace nidus {
namespace {

struct ImportOptions {
  std::string file;
  bool merges = false;
};

ExitStatus importHomes(const ImportOptions& options, Workspace& workspace) {
  const auto homes = readHomes(options.file);
  if (!homes) return report(homes.failure());
  const auto session = workspace.home();
  if (!session) return report(session.failure());
  if (auto failure = (*session)->platform().importHomes(*homes, options.merges)) {
    return report(*failure);
  }
  return printText("imported " + sizeOf(*homes) + '\n');
}

}  // namespace

void declareHomeImport(CommandSyntax& home, Workspace& workspace) {
  const auto options = std::make_shared<ImportOptions>();
  CommandSyntax& syntax =
      home.command("import", "Puts the homes of a document in place of all homes",
                   "The document is checked whole before anything is changed. Try it first with "
                   "nidus home check FILE.");
  syntax.requiredArgument("FILE", options->file, "A home document; - reads standard input");
  syntax.candidates("FILE", {{CandidateKind::files}});
  syntax.flag("--merge", options->merges,
              "Replace only the homes of the same UUID and keep the others");
  syntax.run([options, &workspace] { return importHomes(*options, workspace); });
}

}  // namespace nidus
