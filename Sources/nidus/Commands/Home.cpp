#include "nidus/CommandSyntax.h"
#include "nidus/Commands/Commands.h"

namespace nidus {

void declareHome(CommandSyntax& program, const Settings& settings) {
  CommandSyntax& home = program.command("home", "Reads, shows and replaces the homes", "");
  declareHomeImport(home, settings);
  declareHomeExport(home, settings);
  declareHomeShow(home, settings);
  declareHomeCheck(home);
}

}  // namespace nidus
