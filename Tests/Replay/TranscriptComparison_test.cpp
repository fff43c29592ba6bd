#include "Replay/TranscriptComparison.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace nidus {
namespace {

using testing::HasSubstr;

struct TextCase {
  std::string label;
  std::string expected;
  std::string printed;
};

TEST(PatternTest, StarStandsForAnything) {
  EXPECT_TRUE(matchesPattern("url/*", "url/6F1C"));
  EXPECT_TRUE(matchesPattern("url/*", "url/"));
  EXPECT_TRUE(matchesPattern("SERVICE(*)", "SERVICE({a: (b)})"));
  EXPECT_TRUE(matchesPattern("*", ""));
  EXPECT_TRUE(matchesPattern("a*b*b", "aXbYbZb"));
}

TEST(PatternTest, TheRestMustBeEqual) {
  EXPECT_FALSE(matchesPattern("url/*", "URL/6F1C"));
  EXPECT_FALSE(matchesPattern("SERVICE(*)", "SERVICE(x"));
  EXPECT_FALSE(matchesPattern("aa*aa", "aaa"));
  EXPECT_FALSE(matchesPattern("plain", "plain and more"));
  EXPECT_FALSE(matchesPattern("", "x"));
}

TEST(TranscriptDifferenceTest, AcceptsWhatMeansTheSame) {
  const std::vector<TextCase> cases = {
      {"equal", R"({"step": 0})", R"({"step":0})"},
      {"keys in another order", R"({"step": 0, "log": []})", R"({"log": [], "step": 0})"},
      {"replies in another order", R"({"replies": [{"a": 1}, {"a": 2}]})",
       R"({"replies": [{"a": 2}, {"a": 1}]})"},
      {"results in another order", R"({"replies": [{"actionResults": [1, 2]}]})",
       R"({"replies": [{"actionResults": [2, 1]}]})"},
      {"calls in another order", R"({"platform": [1, 2, 1]})", R"({"platform": [1, 1, 2]})"},
      {"writes in another order", R"({"platform": [{"writes": [1, 2]}]})",
       R"({"platform": [{"writes": [2, 1]}]})"},
      {"messages in another order", R"({"log": ["b", "a"]})", R"({"log": ["a", "b"]})"},
      {"greedy wildcard", R"({"log": ["*", "a*", "ab"]})", R"({"log": ["ab", "ac", "x"]})"},
      {"float written otherwise", R"({"v": 22.22222137451172})", R"({"v": 22.222221})"},
      {"last line without its end", "{\"step\": 0}\n", "{\"step\": 0}"},
  };
  for (const TextCase& c : cases) {
    SCOPED_TRACE(c.label);
    EXPECT_EQ(transcriptDifference(c.expected, c.printed), std::nullopt);
  }
}

TEST(TranscriptDifferenceTest, FindsEveryKindOfDifference) {
  const std::vector<TextCase> cases = {
      {"integer for float", R"({"v": 5.0})", R"({"v": 5})"},
      {"float for integer", R"({"v": 5})", R"({"v": 5.0})"},
      {"next float", R"({"v": 22.222221})", R"({"v": 22.222223})"},
      {"boolean for integer", R"({"v": 1})", R"({"v": true})"},
      {"null for absence", R"({})", R"({"v": null})"},
      {"absence for null", R"({"v": null})", R"({})"},
      {"other letter case", R"({"v": "A"})", R"({"v": "a"})"},
      {"star printed only", R"({"v": "a"})", R"({"v": "*"})"},
      {"other order of a read", R"({"characteristics": [1, 2]})", R"({"characteristics": [2, 1]})"},
      {"other order of records", R"({"records": [1, 2]})", R"({"records": [2, 1]})"},
      {"other order of changes", R"({"changes": [1, 2]})", R"({"changes": [2, 1]})"},
      {"reply missing", R"({"replies": [1, 2]})", R"({"replies": [1]})"},
      {"reply doubled", R"({"replies": [1]})", R"({"replies": [1, 1]})"},
      {"other multiplicity", R"({"log": ["a", "a", "b"]})", R"({"log": ["a", "b", "b"]})"},
      {"two patterns for one", R"({"log": ["a*", "ab"]})", R"({"log": ["ab", "x"]})"},
      {"object for list", R"({"log": []})", R"({"log": {}})"},
      {"change missing", R"({"changes": [1, 2]})", R"({"changes": [1]})"},
      {"line missing", "{\"step\": 0}\n{\"step\": 1}\n", "{\"step\": 0}\n"},
      {"line too much", "{\"step\": 0}\n", "{\"step\": 0}\n{\"step\": 1}\n"},
      {"empty line", "{\"step\": 0}\n", "\n{\"step\": 0}\n"},
      {"no JSON", R"({"step": 0})", "step 0"},
  };
  for (const TextCase& c : cases) {
    SCOPED_TRACE(c.label);
    EXPECT_NE(transcriptDifference(c.expected, c.printed), std::nullopt);
  }
}

TEST(TranscriptDifferenceTest, NamesThePlace) {
  const auto difference = transcriptDifference(
      "{\"step\": 0}\n{\"step\": 1, \"changes\": [{\"after\": null}, {\"after\": \"1\"}]}\n",
      "{\"step\": 0}\n{\"step\": 1, \"changes\": [{\"after\": null}, {\"after\": \"2\"}]}\n");
  ASSERT_NE(difference, std::nullopt);
  EXPECT_THAT(*difference, HasSubstr("line 2/changes/1/after: expected \"1\", printed \"2\""));
}

TEST(TranscriptDifferenceTest, NamesTheElementWithoutPartner) {
  const auto difference =
      transcriptDifference(R"({"log": ["kept", "lost"]})", R"({"log": ["other", "kept"]})");
  ASSERT_NE(difference, std::nullopt);
  EXPECT_THAT(*difference, HasSubstr("line 1/log: expected \"lost\""));
}

}  // namespace
}  // namespace nidus
