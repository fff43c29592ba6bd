#include "nidus/CommandSyntax.h"
#include "nidus/Commands/Commands.h"

namespace nidus {

void declareHome(CommandSyntax& program, Workspace& workspace) {
  CommandSyntax& home = program.command("home", "Reads, shows and replaces the homes", "");
  declareHomeImport(home, workspace);
  declareHomeExport(home, workspace);
  declareHomeShow(home, workspace);
  declareHomeCheck(home);
}

}  // namespace nidus
