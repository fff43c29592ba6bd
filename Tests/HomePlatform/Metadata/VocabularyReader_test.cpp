#include "HomePlatform/Metadata/VocabularyReader.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "Support/TestFolder.h"

namespace nidus {
namespace {

using testing::EndsWith;
using testing::HasSubstr;
using testing::StartsWith;

Result<Vocabulary> extend(const std::string& lists) {
  return mergeVocabulary(builtInVocabulary(), R"({"format": "nidus-vocabulary/1", )" + lists + "}",
                         "mine.json");
}

TEST(VocabularyReaderTest, CarriesTheFileInside) {
  const Vocabulary vocabulary = builtInVocabulary();
  EXPECT_EQ(vocabulary.services.front().assistantName, "LIGHT");
  EXPECT_EQ(vocabulary.characteristics.back().assistantName, "ENABLED");
  EXPECT_EQ(vocabulary.units.back().unit, "ppm");
}

TEST(VocabularyReaderTest, ReadsAllOfAnEntry) {
  const auto vocabulary = mergeVocabulary(
      {}, R"({"format": "nidus-vocabulary/1", "characteristics": [{"assistantName": "A",
              "read": "r", "write": "w", "valueType": "int", "unit": "u", "localized": true,
              "follows": true, "values": [{"assistant": "ON", "platform": 1.5}]}]})",
      "mine.json");
  ASSERT_TRUE(vocabulary);
  const CharacteristicEntry& entry = vocabulary->characteristics.at(0);
  EXPECT_EQ(entry.read, "r");
  EXPECT_EQ(entry.write, "w");
  EXPECT_EQ(entry.valueType, "int");
  EXPECT_EQ(entry.unit, "u");
  EXPECT_TRUE(entry.localized && entry.follows);
  EXPECT_EQ(entry.values.at(0).assistant->stringValue(), "ON");
  EXPECT_EQ(entry.values.at(0).platform->floatValue(), 1.5F);
}

TEST(VocabularyReaderTest, AddsEntriesAtTheEnd) {
  const auto vocabulary = extend(
      R"("services": [{"assistantName": "SAUNA", "serviceType": "my.sauna"}],
         "units": [{"assistantName": "KELVIN", "unit": "kelvin"}])");
  ASSERT_TRUE(vocabulary);
  EXPECT_EQ(vocabulary->services.back().serviceType, "my.sauna");
  EXPECT_EQ(vocabulary->units.back().unit, "kelvin");
}

TEST(VocabularyReaderTest, ReplacesEntryOfSameName) {
  const auto vocabulary =
      extend(R"("services": [{"assistantName": "LIGHT", "serviceType": "my.light"}])");
  ASSERT_TRUE(vocabulary);
  EXPECT_EQ(vocabulary->services.size(), 30U);
  EXPECT_EQ(vocabulary->services.front().serviceType, "my.light");
}

TEST(VocabularyReaderTest, LetsNamesTradeTypes) {
  EXPECT_TRUE(extend(
      R"("services": [
           {"assistantName": "LIGHT", "serviceType": "com.corvane.nidus.service.switch"},
           {"assistantName": "SWITCH", "serviceType": "com.corvane.nidus.service.light"}])"));
}

struct RefusalCase {
  const char* label;
  const char* lists;
  const char* message;  ///< How it begins.
};

class VocabularyRefusalTest : public testing::TestWithParam<RefusalCase> {};

TEST_P(VocabularyRefusalTest, NamesFileAndPlace) {
  const auto vocabulary = extend(GetParam().lists);
  ASSERT_FALSE(vocabulary);
  EXPECT_THAT(vocabulary.failure().message, StartsWith(GetParam().message));
  EXPECT_EQ(vocabulary.failure().kind, Failure::Kind::badInput);
}

const RefusalCase kRefusals[] = {
    {"TwiceInOneFile",
     R"("units": [{"assistantName": "K", "unit": "a"}, {"assistantName": "K", "unit": "b"}])",
     "mine.json: /units/1/assistantName: "},
    {"ServiceTypeOfBuiltIn",
     R"("services": [{"assistantName": "LAMP", "serviceType": "com.corvane.nidus.service.light"}])",
     "mine.json: /services/0/serviceType: "},
    {"TypeOfAReplacedEarlierEntry",
     R"("services": [{"assistantName": "LIGHT", "serviceType": "com.corvane.nidus.service.fan"}])",
     "mine.json: /services/0/serviceType: "},
    {"ReadTypeWrittenByOther",
     R"("characteristics": [{"assistantName": "X", "valueType": "int",
        "read": "com.corvane.nidus.characteristic.target-temperature"}])",
     "mine.json: /characteristics/0/read: "},
    {"WriteTypeReadByOther",
     R"("characteristics": [{"assistantName": "X", "valueType": "int", "read": "x",
        "write": "com.corvane.nidus.characteristic.light-level"}])",
     "mine.json: /characteristics/0/write: "},
    {"UnitTwice", R"("units": [{"assistantName": "K", "unit": "k"},
        {"assistantName": "KK", "unit": "k"}])",
     "mine.json: /units/1/unit: "},
    {"UnknownKey", R"("units": [{"assistantName": "K", "unit": "k", "size": 1}])",
     "mine.json: /units/0/size: "},
    {"UnknownList", R"("rooms": [])", "mine.json: /rooms: "},
    {"MissingValueType", R"("characteristics": [{"assistantName": "X"}])",
     "mine.json: /characteristics/0: "},
    {"ValueOfNoKind", R"("characteristics": [{"assistantName": "X", "valueType": "int",
        "values": [{"assistant": null, "platform": 1}]}])",
     "mine.json: /characteristics/0/values/0/assistant: "},
    {"FlagOfWrongType", R"("characteristics": [{"assistantName": "X", "valueType": "int",
        "localized": 1}])",
     "mine.json: /characteristics/0/localized: "},
    {"ListOfWrongType", R"("units": {})", "mine.json: /units: "},
};

INSTANTIATE_TEST_SUITE_P(Refusals, VocabularyRefusalTest, testing::ValuesIn(kRefusals),
                         [](const auto& tested) { return std::string(tested.param.label); });

TEST(VocabularyReaderTest, RefusesOtherFormats) {
  const auto vocabulary = mergeVocabulary({}, R"({"format": "nidus-vocabulary/2"})", "mine.json");
  ASSERT_FALSE(vocabulary);
  EXPECT_THAT(vocabulary.failure().message, StartsWith("mine.json: /format: "));
}

TEST(VocabularyReaderTest, NamesTheOtherEntry) {
  const auto vocabulary = extend(R"("units": [{"assistantName": "K", "unit": "celsius"}])");
  ASSERT_FALSE(vocabulary);
  EXPECT_THAT(vocabulary.failure().message, HasSubstr("CELSIUS"));
}

TEST(VocabularyReaderTest, MissingFileLeavesBuiltIn) {
  const TestFolder folder;
  const auto vocabulary = loadVocabulary(folder.path() / "vocabulary.json");
  ASSERT_TRUE(vocabulary);
  EXPECT_EQ(vocabulary->services.size(), 30U);
}

TEST(VocabularyReaderTest, ReadsTheFileOfTheUser) {
  const TestFolder folder;
  folder.write("vocabulary.json", R"({"format": "nidus-vocabulary/1",
                                      "units": [{"assistantName": "K", "unit": "kelvin"}]})");
  const auto vocabulary = loadVocabulary(folder.path() / "vocabulary.json");
  ASSERT_TRUE(vocabulary);
  EXPECT_EQ(vocabulary->units.back().assistantName, "K");
}

TEST(VocabularyReaderTest, NamesTheRemedyOfBadFiles) {
  const TestFolder folder;
  folder.write("vocabulary.json", "{}");
  const auto vocabulary = loadVocabulary(folder.path() / "vocabulary.json");
  ASSERT_FALSE(vocabulary);
  EXPECT_EQ(vocabulary.failure().kind, Failure::Kind::badInput);
  EXPECT_THAT(vocabulary.failure().message, EndsWith("; correct the file or remove it"));
}

}  // namespace
}  // namespace nidus
