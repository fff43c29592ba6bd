#include "HomePlatform/Json/JsonText.h"
#include "nidus/CommandSyntax.h"
#include "nidus/Commands/Commands.h"
#include "nidus/Commands/ExitStatusText.h"
#include "nidus/StandardStreams.h"
#include "nidus/Workspace.h"

namespace nidus {
namespace {

ExitStatus printRecords(Workspace& workspace) {
  const auto session = workspace.assistant();
  if (!session) return report(session.failure());
  const auto records = (*session)->runner().records();
  if (!records) return report(records.failure());
  std::string lines;
  for (const NDDictionaryValue& record : *records) {
    appendJson(lines, record);
    lines += '\n';
  }
  return (*session)->statusAfter(printText(lines));
}

}  // namespace

void declareRecords(CommandSyntax& program, Workspace& workspace) {
  CommandSyntax& syntax =
      program.command("records", "Prints the objects that a filter is resolved against",
                      std::string("JSON lines, one record a line, in the order of the home.\n\n"
                                  "Example: how many are there?\n  nidus records | wc -l") +
                          kExitStatuses);
  syntax.run([&workspace] { return printRecords(workspace); });
}

}  // namespace nidus
