#include <memory>

#include "HomePlatform/System/OneLine.h"
#include "nidus/CommandSyntax.h"
#include "nidus/Commands/Commands.h"
#include "nidus/Commands/ExitStatusText.h"
#include "nidus/Commands/HomeInput.h"
#include "nidus/StandardStreams.h"

namespace nidus {
namespace {

ExitStatus checkHomes(const std::string& file) {
  const auto homes = readHomes(file);
  if (!homes) return report(homes.failure());
  return printText(onOneLine(file) + ": " + sizeOf(*homes) + '\n');
}

}  // namespace

void declareHomeCheck(CommandSyntax& home) {
  const auto file = std::make_shared<std::string>();
  CommandSyntax& syntax =
      home.command("check", "Checks a home document and changes nothing",
                   std::string("Says what is wrong and where, as a JSON pointer.\n\nExample:\n  "
                               "nidus home check home.json") +
                       kExitStatuses);
  syntax.requiredArgument("FILE", *file, "A home document; - reads standard input");
  syntax.candidates("FILE", {{CandidateKind::files}});
  syntax.run([file] { return checkHomes(*file); });
}

}  // namespace nidus
