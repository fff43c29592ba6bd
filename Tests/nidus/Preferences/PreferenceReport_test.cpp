#include "nidus/Preferences/PreferenceReport.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace nidus {
namespace {

using ::testing::AllOf;
using ::testing::HasSubstr;
using ::testing::Not;
using ::testing::StartsWith;
using Rule = NDLogThreshold::Rule;

JsonValue integer(std::int64_t value) { return JsonValue{value}; }

/// What is reported on a key of a platform in memory.
PreferenceReport reported(const char* key, const std::map<std::string, JsonValue>& preferences,
                          const NDLogThreshold& threshold) {
  HomePlatformOptions options;
  options.drainsOnCaller = true;
  options.preferences = preferences;
  const auto platform = HomePlatform::open(std::move(options));
  PreferenceReport report = reportOn(*findPreferenceKey(key), **platform, threshold);
  (*platform)->shutDown();
  return report;
}

NDLogThreshold customer(std::int32_t level, Rule rule) { return {level, rule, 4, 3, 7, false}; }

TEST(PreferenceKeysTest, KnowsTheirNames) {
  EXPECT_EQ(findPreferenceKey("InternalBuild")->kind, PreferenceKey::Kind::flag);
  EXPECT_FALSE(findPreferenceKey("internalbuild"));
  EXPECT_THAT(unknownPreference("NidusLogLvl").message,
              AllOf(HasSubstr("did you mean NidusLogLevel?"), HasSubstr("InternalBuild")));
  EXPECT_THAT(unknownPreference("xyzzy").message,
              AllOf(Not(HasSubstr("did you mean")), HasSubstr("they are kHomesConfigured, ")));
}

struct ReadCase {
  const char* key;
  const char* text;
  JsonValue value;  ///< Null when the text is refused.
};

TEST(PreferenceKeysTest, ReadsWhatTheirReadersTake) {
  const ReadCase table[] = {
      {"InternalBuild", "true", {true}},
      {"InternalBuild", "no", {false}},
      {"InternalBuild", "1", {}},
      {"InternalBuild", "\"true\"", {}},
      {"InternalBuild", "null", {}},
      {"NidusLogLevel", "7", integer(7)},
      {"NidusLogLevel", "-1", integer(-1)},
      {"NidusLogLevel", "7.0", {}},
      {"NidusLogLevel", "debug", integer(7)},
      {"NidusLogLevel", "error", integer(3)},
      {"NidusLogLevel", "loud", {}},
      {"NidusLogLevel", "true", {}},
      {"NidusLogLevel", "", {}},
      {"NidusLogLevel", "99999999999999999999", {}},
  };
  for (const ReadCase& each : table) {
    SCOPED_TRACE(std::string(each.key) + " " + each.text);
    const auto value = readPreference(*findPreferenceKey(each.key), each.text);
    EXPECT_EQ(value ? *value : JsonValue(), each.value);
  }
}

TEST(PreferenceKeysTest, TellsWhatTheyTake) {
  const auto refusal = [](const char* key) {
    return readPreference(*findPreferenceKey(key), "x").failure().message;
  };
  EXPECT_EQ(refusal("InternalBuild"),
            "InternalBuild: \"x\" would not be valid; give true or false");
  EXPECT_THAT(refusal("NidusLogLevel"), HasSubstr("error, warning, notice, info or debug"));
}

TEST(PreferenceKeysTest, NamesLevels) {
  EXPECT_EQ(levelText(0), "0 (emergency)");
  EXPECT_EQ(levelText(4), "4 (warning)");
  EXPECT_EQ(levelText(7), "7 (debug)");
  EXPECT_EQ(levelText(9), "9 (as 7, debug)");
  EXPECT_EQ(levelText(-1), "-1");
}

struct EffectCase {
  const char* key;
  std::map<std::string, JsonValue> preferences;
  NDLogThreshold threshold;
  const char* effect;
};

TEST(PreferenceReportTest, TellsWhichRuleDecides) {
  const EffectCase table[] = {
      {"NidusLogLevel",
       {},
       customer(4, Rule::floor),
       "the log level is 4 (warning), the default of a customer build"},
      {"NidusLogLevel",
       {{"NidusLogLevel", integer(7)}},
       customer(7, Rule::level),
       "the log level is 7 (debug) by NidusLogLevel"},
      {"NidusLogLevel",
       {{"NidusLogLevel", integer(2)}},
       customer(5, Rule::developerLevel),
       "it does not count, as it is below 3: the log level is 5 (notice) by "
       "NidusDeveloperLogLevel"},
      {"NidusDeveloperLogLevel",
       {{"NidusDeveloperLogLevel", integer(9)}},
       customer(4, Rule::floor),
       "it does not count, as it is not from 4 to 7: the log level is 4 (warning), the default of "
       "a customer build"},
      {"NidusDeveloperLogLevel",
       {{"NidusDeveloperLogLevel", integer(6)}},
       customer(3, Rule::level),
       "it does not count, as NidusLogLevel comes first: the log level is 3 (error) by "
       "NidusLogLevel"},
      {"NidusDeveloperLogLevel",
       {{"NidusDeveloperLogLevel", integer(6)}},
       customer(6, Rule::developerLevel),
       "the log level is 6 (info) by NidusDeveloperLogLevel"},
      {"InternalBuild",
       {},
       NDLogThreshold{6, Rule::floor, 6, 3, 7, true},
       "this is an internal build, whose default log level is 6 (info); programs that run ask for "
       "it once"},
  };
  for (const EffectCase& each : table) {
    EXPECT_EQ(reported(each.key, each.preferences, each.threshold).effect, each.effect);
  }
}

TEST(PreferenceReportTest, TellsWhetherHomesAreLookedFor) {
  const auto threshold = customer(4, Rule::floor);
  const auto effect = [&threshold](const std::map<std::string, JsonValue>& preferences) {
    return reported("kHomesConfigured", preferences, threshold).effect;
  };
  EXPECT_THAT(effect({}), HasSubstr("find nothing"));
  EXPECT_THAT(effect({{"kHomesConfigured", JsonValue{false}}}), HasSubstr("find nothing"));
  EXPECT_THAT(effect({{"kHomesConfigured", JsonValue{true}}}), HasSubstr("look for the homes"));
}

TEST(PreferenceReportTest, TellsOfAValueThatIsNotValid) {
  const auto report =
      reported("NidusLogLevel", {{"NidusLogLevel", {std::string("7")}}}, customer(4, Rule::floor));
  EXPECT_EQ(report.value, JsonValue{std::string("7")});
  EXPECT_THAT(report.effect, AllOf(StartsWith("it is not valid and counts as not set"),
                                   HasSubstr("the log level is 4 (warning)")));
}

}  // namespace
}  // namespace nidus
