#include "HomePlatform/Metadata/MetadataMapper.h"

#include <gtest/gtest.h>

#include "HomePlatform/Metadata/VocabularyReader.h"

namespace nidus {
namespace {

class MetadataMapperTest : public testing::Test {
 protected:
  const Vocabulary vocabulary_ = builtInVocabulary();
  const MetadataMapper mapper_{vocabulary_};
};

NDString type(const char* name) { return std::string("com.corvane.nidus.characteristic.") + name; }

TEST_F(MetadataMapperTest, MapsEveryServiceBothWays) {
  ASSERT_EQ(vocabulary_.services.size(), 30U);
  for (const ServiceEntry& entry : vocabulary_.services) {
    SCOPED_TRACE(entry.assistantName.str());
    EXPECT_EQ(mapper_.mapFromAssistantServiceName(entry.assistantName), entry.serviceType);
    EXPECT_EQ(mapper_.mapToAssistantServiceName(entry.serviceType), entry.assistantName);
  }
}

TEST_F(MetadataMapperTest, MapsEveryUnitBothWays) {
  ASSERT_EQ(vocabulary_.units.size(), 7U);
  for (const UnitEntry& entry : vocabulary_.units) {
    SCOPED_TRACE(entry.assistantName.str());
    EXPECT_EQ(mapper_.mapFromAssistantUnitName(entry.assistantName), entry.unit);
    EXPECT_EQ(mapper_.mapToAssistantUnitName(entry.unit), entry.assistantName);
  }
}

TEST_F(MetadataMapperTest, MapsEveryCharacteristicByName) {
  ASSERT_EQ(vocabulary_.characteristics.size(), 33U);
  for (const CharacteristicEntry& entry : vocabulary_.characteristics) {
    SCOPED_TRACE(entry.assistantName.str());
    const NDString& name = entry.assistantName;
    EXPECT_EQ(mapper_.mapReadCharcteristicFromAssistantName(name), entry.read);
    EXPECT_EQ(mapper_.mapWriteCharcteristicFromAssistantName(name), entry.write);
    EXPECT_EQ(mapper_.mapCharacteristicValueType(name), entry.valueType);
  }
}

TEST_F(MetadataMapperTest, MapsEveryCharacteristicByType) {
  for (const CharacteristicEntry& entry : vocabulary_.characteristics) {
    for (const NDString& known : {entry.read, entry.write}) {
      if (!known) continue;
      SCOPED_TRACE(known.str());
      EXPECT_EQ(mapper_.mapToAssistantCharacteristicName(known), entry.assistantName);
      EXPECT_EQ(mapper_.mapReadCharcteristicFromAssistantName(known), entry.read);
      EXPECT_EQ(mapper_.mapWriteCharcteristicFromAssistantName(known), entry.write);
      EXPECT_EQ(mapper_.mapCharacteristicValueType(known), entry.valueType);
      EXPECT_EQ(mapper_.characteristicValueUnit(known), entry.unit);
      EXPECT_EQ(mapper_.supportsLocalization(known), entry.localized);
    }
  }
}

TEST_F(MetadataMapperTest, MapsEveryValueOfEveryPair) {
  for (const CharacteristicEntry& entry : vocabulary_.characteristics) {
    for (const ValuePair& pair : entry.values) {
      SCOPED_TRACE(entry.assistantName.str() + ' ' + description(pair.platform));
      const auto toAssistant =
          mapper_.mapToAssistantCharacteristicValue_name(pair.platform, entry.assistantName);
      EXPECT_TRUE(toAssistant->isEqual(*pair.assistant));
      const auto back =
          mapper_.mapFromAssistantCharacteristicValue_name(pair.assistant, entry.assistantName);
      const auto there = mapper_.mapToAssistantCharacteristicValue_name(back, entry.assistantName);
      EXPECT_TRUE(there->isEqual(*pair.assistant));
    }
  }
}

TEST_F(MetadataMapperTest, SplitsTemperatureByDirection) {
  EXPECT_EQ(mapper_.mapReadCharcteristicFromAssistantName("TEMPERATURE"),
            type("current-temperature"));
  EXPECT_EQ(mapper_.mapWriteCharcteristicFromAssistantName("TEMPERATURE"),
            type("target-temperature"));
  EXPECT_TRUE(mapper_.supportsLocalization(type("target-temperature")));
  EXPECT_EQ(mapper_.characteristicValueUnit(type("current-temperature")), "celsius");
}

TEST_F(MetadataMapperTest, MapsUnknownNamesToNull) {
  for (const NDString& name : {NDString("UNKNOWN"), NDString(""), NDString()}) {
    SCOPED_TRACE(name.str());
    EXPECT_FALSE(mapper_.mapFromAssistantServiceName(name));
    EXPECT_FALSE(mapper_.mapToAssistantServiceName(name));
    EXPECT_FALSE(mapper_.mapToAssistantCharacteristicName(name));
    EXPECT_FALSE(mapper_.mapReadCharcteristicFromAssistantName(name));
    EXPECT_FALSE(mapper_.mapWriteCharcteristicFromAssistantName(name));
    EXPECT_FALSE(mapper_.mapCharacteristicValueType(name));
    EXPECT_FALSE(mapper_.mapFromAssistantUnitName(name));
    EXPECT_FALSE(mapper_.mapToAssistantUnitName(name));
    EXPECT_FALSE(mapper_.characteristicValueUnit(name));
    EXPECT_FALSE(mapper_.supportsLocalization(name));
  }
}

TEST_F(MetadataMapperTest, TakesTypesAloneWhereTypesAreMeant) {
  EXPECT_FALSE(mapper_.mapToAssistantCharacteristicName("POWER"));
  EXPECT_FALSE(mapper_.characteristicValueUnit("BRIGHTNESS"));
  EXPECT_FALSE(mapper_.supportsLocalization("TEMPERATURE"));
}

TEST_F(MetadataMapperTest, GivesUnmappedValueItself) {
  const NDValueRef value = NDValue::integer(9);
  for (const char* name : {"CLIMATE_MODE", "POWER", "UNKNOWN"}) {
    SCOPED_TRACE(name);
    EXPECT_EQ(mapper_.mapToAssistantCharacteristicValue_name(value, name), value);
    EXPECT_EQ(mapper_.mapFromAssistantCharacteristicValue_name(value, name), value);
  }
  EXPECT_EQ(mapper_.mapToAssistantCharacteristicValue_name(value, nullptr), value);
}

TEST_F(MetadataMapperTest, MapsNullValueToNull) {
  EXPECT_FALSE(mapper_.mapToAssistantCharacteristicValue_name(nullptr, "LOCKED"));
  EXPECT_FALSE(mapper_.mapFromAssistantCharacteristicValue_name(nullptr, "LOCKED"));
}

TEST_F(MetadataMapperTest, ComparesNumbersByNumber) {
  const NDValueRef fromTrue =
      mapper_.mapToAssistantCharacteristicValue_name(NDValue::boolean(true), "CLIMATE_MODE");
  EXPECT_EQ(fromTrue->stringValue(), "HEAT");
  const NDValueRef fromFloat =
      mapper_.mapToAssistantCharacteristicValue_name(NDValue::floating(2.0F), "CLIMATE_MODE");
  EXPECT_EQ(fromFloat->stringValue(), "COOL");
}

TEST_F(MetadataMapperTest, ComparesTextsAsTheyStand) {
  const NDValueRef lower = NDValue::text("heat");
  EXPECT_EQ(mapper_.mapFromAssistantCharacteristicValue_name(lower, "CLIMATE_MODE"), lower);
  const NDValueRef digit = NDValue::text("1");
  EXPECT_EQ(mapper_.mapToAssistantCharacteristicValue_name(digit, "CLIMATE_MODE"), digit);
}

TEST_F(MetadataMapperTest, FirstPairOfSeveralWins) {
  const NDValueRef unlocked =
      mapper_.mapFromAssistantCharacteristicValue_name(NDValue::boolean(false), "LOCKED");
  EXPECT_EQ(unlocked->integerValue(), 0);
}

TEST_F(MetadataMapperTest, MapsValuesByTypeToo) {
  const NDValueRef locked = mapper_.mapToAssistantCharacteristicValue_name(
      NDValue::integer(1), type("current-lock-state"));
  ASSERT_TRUE(locked->isBoolean());
  EXPECT_TRUE(locked->boolValue());
}

TEST_F(MetadataMapperTest, KnowsWhatFollowsAWrite) {
  EXPECT_EQ(mapper_.followingType(type("target-lock-state")), type("current-lock-state"));
  EXPECT_FALSE(mapper_.followingType(type("current-lock-state")));
  EXPECT_FALSE(mapper_.followingType(type("target-temperature")));
  EXPECT_FALSE(mapper_.followingType(type("power")));
  EXPECT_FALSE(mapper_.followingType("LOCKED"));
  EXPECT_FALSE(mapper_.followingType(nullptr));
}

TEST(MetadataMapperFollowsTest, NothingFollowsItself) {
  Vocabulary vocabulary;
  vocabulary.characteristics.push_back({"A", "t", "t", "int", nullptr, false, true, {}});
  EXPECT_FALSE(MetadataMapper(vocabulary).followingType("t"));
}

}  // namespace
}  // namespace nidus
