#include "Assistant/HomeObjectRecord.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace nidus {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;

HomeObjectRecord fullRecord() {
  HomeObjectRecord record;
  record.objectType = "SERVICE";
  record.objectName = "Lamp";
  record.objectIdentifier = NDURL::make("x-corvane-nidus", "local", "/service?id=1");
  record.objectHome = "Cabin";
  record.objectRoom = "Kitchen";
  record.objectZone = "Ground floor";
  record.objectGroups = {"Evening", "Night"};
  record.objectServiceType = "light";
  record.objectAssociatedServiceType = "outlet";
  record.objectCharacteristics = {"power", "brightness"};
  return record;
}

std::vector<std::string> keysOf(const NDDictionary& dictionary) {
  std::vector<std::string> keys;
  for (const auto& [key, value] : dictionary) keys.emplace_back(key);
  return keys;
}

TEST(HomeObjectRecordTest, DictionaryHasAllKeys) {
  EXPECT_THAT(keysOf(fullRecord().dictionary()),
              ElementsAre("objectType", "objectName", "objectIdentifier", "objectHome",
                          "objectRoom", "objectZone", "objectGroups", "objectServiceType",
                          "objectAssociatedServiceType", "objectCharacteristics"));
}

TEST(HomeObjectRecordTest, DictionaryLeavesAbsentKeysOut) {
  EXPECT_THAT(keysOf(HomeObjectRecord().dictionary()), IsEmpty());
}

TEST(HomeObjectRecordTest, DictionaryKeepsEmptyTexts) {
  HomeObjectRecord record;
  record.objectName = "";
  EXPECT_THAT(keysOf(record.dictionary()), ElementsAre("objectName"));
}

TEST(HomeObjectRecordTest, DictionaryHoldsTextsAndLists) {
  const NDDictionary dictionary = fullRecord().dictionary();
  EXPECT_EQ(std::get<NDString>(dictionary.find("objectIdentifier")->content()),
            "x-corvane-nidus://local/service?id=1");
  const auto& groups = std::get<NDDictionaryList>(dictionary.find("objectGroups")->content());
  ASSERT_EQ(groups.size(), 2U);
  EXPECT_EQ(std::get<NDString>(groups[1].content()), "Night");
}

TEST(HomeObjectRecordTest, DescriptionShowsAllFields) {
  EXPECT_EQ(description(fullRecord()),
            "{objectType: SERVICE, objectName: Lamp, "
            "objectIdentifier: x-corvane-nidus://local/service?id=1, objectHome: Cabin, "
            "objectRoom: Kitchen, objectZone: Ground floor, objectGroups: [Evening, Night], "
            "objectServiceType: light, objectAssociatedServiceType: outlet, "
            "objectCharacteristics: [power, brightness]}");
}

TEST(HomeObjectRecordTest, DescriptionLeavesAbsentFieldsOut) {
  EXPECT_EQ(description(HomeObjectRecord()), "{}");
}

TEST(HomeObjectRecordTest, DescriptionKeepsToOneLine) {
  HomeObjectRecord record;
  record.objectName = "a\nb\r\\";
  record.objectGroups = {"c\nd"};
  EXPECT_EQ(description(record), R"({objectName: a\nb\r\\, objectGroups: [c\nd]})");
}

TEST(HomeObjectRecordTest, DescriptionJoinsTheRecordsOfAList) {
  HomeObjectRecord record;
  record.objectName = "Lamp";
  EXPECT_EQ(description(HomeObjectRecords{record, {}}), "[{objectName: Lamp}, {}]");
}

}  // namespace
}  // namespace nidus
