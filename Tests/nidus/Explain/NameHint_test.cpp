#include "nidus/Explain/NameHint.h"

#include <gtest/gtest.h>

#include "HomePlatform/Metadata/MetadataMapper.h"
#include "HomePlatform/Metadata/VocabularyReader.h"
#include "nidus/Explain/Records.h"

namespace nidus {
namespace {

using Fields = std::vector<std::pair<std::string, std::string>>;

NDDictionaryValue record(const Fields& fields) {
  NDDictionary dictionary;
  for (const auto& [key, text] : fields) dictionary.set(key, NDDictionaryValue(NDString(text)));
  return NDDictionaryValue(dictionary);
}

const NDDictionaryList kSnapshot = {
    record({{"objectType", "HOME"}, {"objectName", "Cabin"}}),
    record({{"objectType", "ROOM"}, {"objectName", "Café"}, {"objectZone", "Downstairs"}}),
    record({{"objectType", "ROOM"}, {"objectName", "Hall"}, {"objectZone", "Downstairs"}}),
    record({{"objectType", "SERVICE"},
            {"objectName", "Lamp"},
            {"objectGroups", "Corner"},
            {"objectServiceType", "com.corvane.nidus.service.outlet"},
            {"objectAssociatedServiceType", "com.corvane.nidus.service.light"},
            {"objectCharacteristics", "com.corvane.nidus.characteristic.power"}}),
};

/// The hints of one step, for a filter that asks for the same wrong name everywhere.
std::string hints(const char* step, const char* name) {
  VAHASearchCriteriaFilter filter;
  filter.setHomeName(name);
  filter.setEntityType(name);
  filter.setServiceType(name);
  filter.setRoomName(name);
  filter.setGroupName(name);
  filter.setServiceName(name);
  filter.setSceneName(name);
  filter.setAttribute(name);
  const MetadataMapper metadata(builtInVocabulary());
  return nameHints(filter, step, kSnapshot, recordsOfType("SERVICE", kSnapshot), metadata);
}

TEST(NameHintTest, KnowsWhatEachStepChoosesFrom) {
  EXPECT_EQ(hints("home", "X"), "There is no home X here. There are: Cabin.\n");
  EXPECT_EQ(hints("entityType", "X"),
            "There is no object of the entity type X here. There are: SERVICE.\n");
  EXPECT_EQ(hints("serviceType", "X"),
            "There is no service of the type X here. There are: OUTLET, LIGHT.\n");
  EXPECT_EQ(hints("room and zone", "X"), "There is no room X here. There are: Café, Hall.\n");
  EXPECT_EQ(hints("group", "X"), "There is no group X here. There are: Corner.\n");
  EXPECT_EQ(hints("serviceName", "X"), "There is no service X here. There are: Lamp.\n");
  EXPECT_EQ(hints("sceneName", "X"), "There is no scene X here. There are: Lamp.\n");
  EXPECT_EQ(hints("attribute", "X"), "There is no attribute X here. There are: POWER.\n");
  EXPECT_EQ(hints("another step", "X"), "");
}

TEST(NameHintTest, TellsRoomFromZone) {
  VAHASearchCriteriaFilter filter;
  filter.setRoomName("Cafe");
  filter.setZoneName("Upstairs");
  const MetadataMapper metadata(builtInVocabulary());
  EXPECT_EQ(nameHints(filter, "room and zone", kSnapshot, {}, metadata),
            "There is the room Cafe, but it matches none of these.\n"
            "There is no zone Upstairs here. There are: Downstairs.\n");
}

TEST(NameHintTest, SuggestsANearMiss) {
  EXPECT_EQ(nameHint("room", "Hal", {"Café", "Hall"}),
            "There is no room Hal here; did you mean Hall? There are: Café, Hall.\n");
  EXPECT_EQ(nameHint("room", "Hal", {}), "There is no room Hal here.\n");
}

TEST(NameHintTest, SuggestsWhatIsWrittenWithAccents) {
  EXPECT_EQ(nameHint("scene", "soiree", {"Night", "Soirée"}),
            "There is no scene soiree here; did you mean Soirée? There are: Night, Soirée.\n");
}

TEST(RecordsTest, NamesTheLastOneLeft) {
  EXPECT_EQ(enumeration(std::vector<std::string>(13, "x")),
            "x, x, x, x, x, x, x, x, x, x, x, x, x");
}

TEST(RecordsTest, ShortensLongLists) {
  std::vector<std::string> texts(14, "x");
  EXPECT_EQ(enumeration(texts), "x, x, x, x, x, x, x, x, x, x, x, x and 2 more");
  EXPECT_EQ(enumeration({}), "");
  EXPECT_EQ(namesOf({record({{"objectType", "SERVICE"}})}), "(no name)");
}

}  // namespace
}  // namespace nidus
