#include "AssistantHost/Replay.h"

#include <memory>

#include "nidus/CommandSyntax.h"
#include "nidus/Commands/Commands.h"
#include "nidus/Commands/ExitStatusText.h"
#include "nidus/Session.h"
#include "nidus/StandardStreams.h"

namespace nidus {
namespace {

ExitStatus replayFile(const std::string& file) {
  const auto scenario = readScenario(file);
  if (!scenario) return report(scenario.failure());
  const auto module = openOwnModule();
  if (!module) return report(module.failure());
  const auto failure = replay(*scenario, **module, writeOutput);
  return failure ? report(*failure) : ExitStatus::success;
}

}  // namespace

void declareReplay(CommandSyntax& program) {
  const auto file = std::make_shared<std::string>();
  CommandSyntax& syntax = program.command(
      "replay", "Runs a scripted scenario and prints its transcript",
      std::string(
          "The scenario runs on homes in memory; nothing of the data folder is read or written.\n\n"
          "Example:\n  nidus replay scenario.json") +
          kExitStatuses);
  syntax.requiredArgument("SCENARIO", *file, "A scenario document");
  syntax.candidates("SCENARIO", {{CandidateKind::files}});
  syntax.run([file] { return replayFile(*file); });
}

}  // namespace nidus
