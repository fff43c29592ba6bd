#include "Logging/WLOThreshold.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <limits>

#include "Logging/WLOLog.h"
#include "Support/FreshProcess.h"
#include "Support/TestPlatform.h"

namespace nidus {
namespace {

using Rule = NDLogThreshold::Rule;

/// What is set, and the rule that decides.
struct RuleCase {
  const char* label;
  std::int64_t level;
  std::int64_t developerLevel;
  bool isInternalBuild;
  Rule rule;
  std::int32_t threshold;
};

void PrintTo(const RuleCase& each, std::ostream* out) { *out << each.label; }

/// Each test has a process of its own, because the kind of the build is asked once.
class WLOThresholdTest : public ::testing::TestWithParam<RuleCase> {
 protected:
  static TestPlatform& platform() { return *TestPlatform::shared(); }
};

TEST_P(WLOThresholdTest, TellsLevelAndRule) {
  inFreshProcess([] {
    platform().testPreferences().setInteger(kWLOLogLevelKey, GetParam().level);
    platform().testPreferences().setInteger("NidusDeveloperLogLevel", GetParam().developerLevel);
    platform().setInternalBuild(NDValue::boolean(GetParam().isInternalBuild));
    const NDLogThreshold threshold = readThreshold(platform());
    EXPECT_EQ(threshold.rule, GetParam().rule);
    EXPECT_EQ(threshold.level, GetParam().threshold);
    EXPECT_EQ(threshold.isInternalBuild, GetParam().isInternalBuild);
    EXPECT_EQ(threshold.floor, GetParam().isInternalBuild ? 6 : 4);
    EXPECT_EQ(threshold.leastLevel, 3);
    EXPECT_EQ(threshold.greatestDeveloperLevel, 7);
  });
}

constexpr std::int32_t kGreatest = std::numeric_limits<std::int32_t>::max();

INSTANTIATE_TEST_SUITE_P(
    Rules, WLOThresholdTest,
    ::testing::Values(RuleCase{"NothingSet", 0, 0, false, Rule::floor, 4},
                      RuleCase{"NothingSetInternal", 0, 0, true, Rule::floor, 6},
                      RuleCase{"LevelTooLow", 2, 0, false, Rule::floor, 4},
                      RuleCase{"LevelThree", 3, 7, false, Rule::level, 3},
                      RuleCase{"LevelThreeInternal", 3, 7, true, Rule::level, 3},
                      RuleCase{"LevelBeyond", std::int64_t{kGreatest} + 1, 0, false, Rule::level,
                               kGreatest},
                      RuleCase{"DeveloperAtFloor", 2, 4, false, Rule::developerLevel, 4},
                      RuleCase{"DeveloperSeven", 0, 7, true, Rule::developerLevel, 7},
                      RuleCase{"DeveloperBelowFloor", 0, 5, true, Rule::floor, 6},
                      RuleCase{"DeveloperEight", 0, 8, false, Rule::floor, 4}),
    [](const auto& test) { return std::string(test.param.label); });

TEST_F(WLOThresholdTest, ReadsPreferencesAnew) {
  inFreshProcess([] {
    EXPECT_EQ(readThreshold(platform()).level, 4);
    platform().testPreferences().setInteger(kWLOLogLevelKey, 7);
    EXPECT_EQ(readThreshold(platform()).level, 7);
  });
}

TEST_F(WLOThresholdTest, OpensNoLog) {
  inFreshProcess([] {
    EXPECT_EQ(readThreshold(platform()).level, 4);
    EXPECT_THAT(platform().testLog().openings(), ::testing::IsEmpty());
    EXPECT_THAT(platform().testNotifications().registrations(), ::testing::IsEmpty());
  });
}

}  // namespace
}  // namespace nidus
