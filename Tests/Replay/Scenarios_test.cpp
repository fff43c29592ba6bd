#include <gtest/gtest.h>

#include <algorithm>
#include <cctype>
#include <filesystem>
#include <set>
#include <string>
#include <vector>

#include "Replay/ReplayRun.h"
#include "Replay/TranscriptComparison.h"
#include "Support/TestFolder.h"

namespace nidus {
namespace {

const std::string kScenarioEnding = ".scenario.json";
const std::string kTranscriptEnding = ".expected.jsonl";

/// The names of the files in the folder of scenarios that have this ending, without it.
std::set<std::string> namesWithEnding(const std::string& ending) {
  std::set<std::string> names;
  for (const auto& entry : std::filesystem::directory_iterator(NIDUS_SCENARIOS)) {
    const std::string name = entry.path().filename().string();
    if (name.ends_with(ending)) names.insert(name.substr(0, name.size() - ending.size()));
  }
  return names;
}

std::filesystem::path fileOf(const std::string& name, const std::string& ending) {
  return std::filesystem::path(NIDUS_SCENARIOS) / (name + ending);
}

/// "read-two-homes" as "ReadTwoHomes".
std::string testNameOf(const testing::TestParamInfo<std::string>& info) {
  std::string name;
  bool isStart = true;
  for (const char c : info.param) {
    if (c != '-') name += isStart ? static_cast<char>(std::toupper(c)) : c;
    isStart = c == '-';
  }
  return name;
}

class ScenarioTest : public testing::TestWithParam<std::string> {};

TEST_P(ScenarioTest, PrintsTheExpectedTranscript) {
  const ReplayRun run = runReplay(fileOf(GetParam(), kScenarioEnding));
  EXPECT_EQ(run.exitStatus, 0);
  EXPECT_EQ(run.errors, "");
  const auto difference =
      transcriptDifference(contentOfFile(fileOf(GetParam(), kTranscriptEnding)), run.output);
  EXPECT_FALSE(difference.has_value()) << difference.value_or("");
}

INSTANTIATE_TEST_SUITE_P(Replay, ScenarioTest, testing::ValuesIn(namesWithEnding(kScenarioEnding)),
                         testNameOf);

TEST(ScenariosTest, EachHasItsTranscript) {
  EXPECT_EQ(namesWithEnding(kScenarioEnding), namesWithEnding(kTranscriptEnding));
}

}  // namespace
}  // namespace nidus
