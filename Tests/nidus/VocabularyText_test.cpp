#include "nidus/VocabularyText.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "HomePlatform/Metadata/VocabularyReader.h"

namespace nidus {
namespace {

using ::testing::AllOf;
using ::testing::HasSubstr;
using ::testing::Not;

/// The line of a text that has `word`; empty when none has.
std::string lineWith(const std::string& text, const std::string& word) {
  const std::size_t found = text.find(word);
  if (found == std::string::npos) return {};
  const std::size_t start = text.rfind('\n', found) + 1;
  return text.substr(start, text.find('\n', found) - start);
}

TEST(VocabularyTextTest, TellsUseValueAndUnit) {
  const std::string text = vocabularyText(builtInVocabulary(), {});
  EXPECT_THAT(
      lineWith(text, "BRIGHTNESS"),
      AllOf(HasSubstr("read and set"), HasSubstr("a whole number"), HasSubstr("percentage")));
  EXPECT_THAT(lineWith(text, "CLIMATE_MODE"), HasSubstr("OFF, HEAT, COOL, AUTO"));
  EXPECT_THAT(lineWith(text, "SWING"), HasSubstr("on, off"));
  EXPECT_THAT(lineWith(text, "IDENTIFY"), HasSubstr("  set "));
  EXPECT_THAT(lineWith(text, "MOTION "), AllOf(HasSubstr("  read "), HasSubstr("on, off")));
  EXPECT_THAT(lineWith(text, "ENABLED "), HasSubstr("runs a scene"));
  EXPECT_THAT(lineWith(text, "HEATING_THRESHOLD "), HasSubstr("celsius (by locale)"));
}

TEST(VocabularyTextTest, ListsTypesAndUnits) {
  const std::string text = vocabularyText(builtInVocabulary(), {});
  EXPECT_THAT(text, HasSubstr("  LIGHT, SWITCH,"));
  EXPECT_THAT(text, HasSubstr("  HOME, ROOM, ZONE, SERVICE, GROUP, SCENE, TRIGGER\n"));
  EXPECT_THAT(text, HasSubstr("  CELSIUS, FAHRENHEIT,"));
}

TEST(VocabularyTextTest, DescribesWordsOfTheUser) {
  const auto own = mergeVocabulary({}, R"({"format": "nidus-vocabulary/1", "characteristics": [
              {"assistantName": "LABEL", "read": "a", "write": "b", "valueType": "string"},
              {"assistantName": "BLOB", "valueType": "data"}]})",
                                   "mine.json");
  ASSERT_TRUE(own);
  const std::string text = vocabularyText(*own, {});
  EXPECT_THAT(lineWith(text, "LABEL"), HasSubstr("a text"));
  EXPECT_THAT(lineWith(text, "BLOB"), AllOf(HasSubstr("neither read nor set"), HasSubstr("data")));
}

TEST(VocabularyTextTest, FindsAWordInEitherCase) {
  const Vocabulary found = entriesMatching(builtInVocabulary(), "light");
  ASSERT_EQ(found.services.size(), 1U);
  EXPECT_EQ(found.services.front().assistantName, "LIGHT");
  EXPECT_TRUE(found.characteristics.empty());
}

TEST(VocabularyTextTest, FindsPartsOfNamesAndValues) {
  const Vocabulary found = entriesMatching(builtInVocabulary(), "heat");
  ASSERT_EQ(found.characteristics.size(), 2U);
  EXPECT_EQ(found.characteristics.front().assistantName, "HEATING_THRESHOLD");
  EXPECT_EQ(found.characteristics.back().assistantName, "CLIMATE_MODE");
  ASSERT_EQ(found.services.size(), 1U);
  EXPECT_EQ(found.services.front().assistantName, "HEATER");
  EXPECT_TRUE(entriesMatching(builtInVocabulary(), "xyzzy").isEmpty());
}

TEST(VocabularyTextTest, DetailsShowWhatDevicesTake) {
  const std::string text = vocabularyDetails(entriesMatching(builtInVocabulary(), "climate_mode"));
  EXPECT_THAT(text, HasSubstr("characteristic.current-climate-mode\n"));
  EXPECT_THAT(text, HasSubstr("characteristic.target-climate-mode\n"));
  EXPECT_THAT(text, HasSubstr("OFF is 0, HEAT is 1, COOL is 2, AUTO is 3\n"));
  EXPECT_THAT(text, HasSubstr("what is set can be read at once\n"));
  EXPECT_THAT(text, Not(HasSubstr("unit")));
}

}  // namespace
}  // namespace nidus
