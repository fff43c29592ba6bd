#include <memory>
#include <sstream>

#include "HomePlatform/Store/HomeDocument.h"
#include "nidus/CommandSyntax.h"
#include "nidus/Commands/Commands.h"
#include "nidus/Commands/ExitStatusText.h"
#include "nidus/FileReplacement.h"
#include "nidus/StandardStreams.h"
#include "nidus/Workspace.h"

namespace nidus {
namespace {

Result<std::string> exportedDocument(Workspace& workspace) {
  const auto session = workspace.home();
  if (!session) return session.failure();
  const auto homes = (*session)->platform().exportHomes();
  if (!homes) return homes.failure();
  std::ostringstream document;
  writeHomeDocument(document, *homes, true);
  return document.str();
}

ExitStatus exportHomes(const std::string& file, Workspace& workspace) {
  const auto document = exportedDocument(workspace);
  if (!document) return report(document.failure());
  if (file == "-") return printText(*document);
  const auto failure = replaceFile(file, *document);
  return failure ? report(*failure) : ExitStatus::success;
}

}  // namespace

void declareHomeExport(CommandSyntax& home, Workspace& workspace) {
  const auto file = std::make_shared<std::string>("-");
  CommandSyntax& syntax = home.command(
      "export", "Writes all homes as a document",
      std::string("A file is replaced whole or not at all. The document can be imported again.\n\n"
                  "Example:\n  nidus home export home.json") +
          kExitStatuses);
  syntax.argument("FILE", *file, "Where to write; standard output when it is left out or -");
  syntax.candidates("FILE", {{CandidateKind::files}});
  syntax.run([file, &workspace] { return exportHomes(*file, workspace); });
}

}  // namespace nidus
