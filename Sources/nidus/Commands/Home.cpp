#include <string>

#include "nidus/CommandSyntax.h"
#include "nidus/Commands/Commands.h"
#include "nidus/Commands/ExitStatusText.h"

namespace nidus {

void declareHome(CommandSyntax& program, Workspace& workspace) {
  CommandSyntax& home =
      program.command("home", "Shows, changes, reads and replaces the homes",
                      std::string("Example:\n  nidus home show") + kQuestionExitStatuses);
  if (!home.isWanted()) return;
  declareHomeImport(home, workspace);
  declareHomeExport(home, workspace);
  declareHomeShow(home, workspace);
  declareHomeCheck(home);
  declareHomeAdd(home, workspace);
  declareHomeRename(home, workspace);
  declareHomeMove(home, workspace);
  declareHomeRemove(home, workspace);
  declareHomeEdit(home, workspace);
  declareHomeRestore(home, workspace);
}

}  // namespace nidus
