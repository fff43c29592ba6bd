#include <variant>

#include "AssistantHost/Scenario.h"
#include "Support/CommandText.h"
#include "Support/Finding.h"
#include "Support/HomeRoundTrip.h"
#include "Support/Refusal.h"
#include "Support/TestFolder.h"

// Scenarios, those whose homes stand in a file beside them included: what is refused is refused
// well, and the homes and the commands of what is read survive.

namespace nidus {
namespace {

/// The folder of the scenario, with homes that it may name.
const TestFolder& folder() {
  static const TestFolder kFolder;
  static const std::string kHomes =
      kFolder.write("homes.json", R"({"format": "nidus-home/1", "homes": []})");
  static const std::string kBad = kFolder.write("bad.json", R"({"format": "nidus-home/1"})");
  return kFolder;
}

/// The file that a refusal is about: the scenario, or the home document that it names.
std::string fileOf(const Failure& failure, const std::string& scenario) {
  if (failure.message.starts_with(scenario + ": ")) return scenario;
  return failure.message.substr(0, failure.message.find(": "));
}

void checkStep(const ScenarioStep& step) {
  if (const auto* perform = std::get_if<PerformStep>(&step)) {
    checkCommandSurvives(*perform->command);
  }
}

void tryScenario(std::string_view text) {
  const std::string file = folder().write("test.scenario.json", text);
  const auto scenario = readScenario(file);
  if (!scenario) {
    return checkRefusal(scenario.failure(), fileOf(scenario.failure(), file));
  }
  checkHomesSurvive(scenario->homes);
  for (const ScenarioStep& step : scenario->steps) checkStep(step);
}

}  // namespace
}  // namespace nidus

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  nidus::tryScenario(nidus::textOf(data, size));
  return 0;
}
