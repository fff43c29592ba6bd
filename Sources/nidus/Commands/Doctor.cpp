#include "nidus/Doctor/Doctor.h"

#include <memory>

#include "nidus/CommandSyntax.h"
#include "nidus/Commands/Commands.h"
#include "nidus/Doctor/DoctorReport.h"
#include "nidus/StandardStreams.h"
#include "nidus/Workspace.h"

namespace nidus {
namespace {

ExitStatus examineAll(bool asJson, Workspace& workspace) {
  const auto folder = dataFolderOf(workspace.settings());
  if (!folder) return report(folder.failure());
  const auto areas = diagnose(examine(*folder));
  const ExitStatus printed =
      printText(asJson ? doctorJson(areas) : doctorText(areas, standardOutputStyle()));
  if (printed != ExitStatus::success) return printed;
  return isWell(areas) ? ExitStatus::success : ExitStatus::otherOutcome;
}

}  // namespace

void declareDoctor(CommandSyntax& program, Workspace& workspace) {
  const auto asJson = std::make_shared<bool>(false);
  CommandSyntax& syntax = program.command(
      "doctor", "Looks for what is wrong, and says how to mend it",
      "Looks at the data folder, the database, the plug-in, the vocabulary, the preferences and\n"
      "the homes; changes nothing. Example:\n"
      "  nidus doctor --data ~/homes\n\n"
      "Exit status: 0 all is well, 1 something needs attention, 2 bad input, 4 the doctor itself "
      "failed.");
  syntax.flag("--json", *asJson, "Print one JSON object instead of lines");
  syntax.run([asJson, &workspace] { return examineAll(*asJson, workspace); });
}

}  // namespace nidus
