#include "nidus/HomeEditing/SceneAction.h"

#include "HomePlatform/Metadata/VocabularyReader.h"
#include "nidus/HomeEditing/HomeAddition.h"
#include "nidus/HomeEditing/SampleHomes.h"

namespace nidus {
namespace {

/// A home with a thermostat that has all kinds of values, and a lamp with brightness.
class SceneActionTest : public ::testing::Test {
 protected:
  SceneActionTest() : vocabulary_(builtInVocabulary()) {
    const ServiceWords thermostat{
        "Heat", "thermostat", "", {"temperature", "climate_mode", "locked", "motion"}};
    EXPECT_TRUE(
        addService(homes_, {ObjectKind::accessory, "Floor lamp", ""}, thermostat, vocabulary_));
  }

  [[nodiscard]] Result<SceneActionData> action(const SettingWords& words,
                                               bool isMetric = true) const {
    const auto place = findObject(homes_, {ObjectKind::service, words.service, ""});
    if (!place) return place.failure();
    return sceneAction(homes_, *place, words, vocabulary_, isMetric);
  }
  [[nodiscard]] std::string value(const std::string& attribute, const std::string& text,
                                  bool isMetric = true) const {
    const auto made = action({"Heat", attribute, text}, isMetric);
    return made ? made->value->description() : made.failure().message;
  }
  MetadataData& targetMetadata() {
    return *homes_[0].accessories[1].services.back().characteristics[1].metadata;
  }

  const Vocabulary vocabulary_;
  std::vector<HomeData> homes_ = sampleHomes();
};

TEST_F(SceneActionTest, AddressesTheCharacteristic) {
  const auto made = action({"Ceiling lamp/Lamp", "brightness", "20%"});
  ASSERT_TRUE(made) << made.failure().message;
  EXPECT_EQ(made->target.accessory, homes_[0].accessories[0].uuid);
  EXPECT_EQ(made->target.service, 8);
  EXPECT_EQ(made->target.characteristic, 10);
  EXPECT_EQ(made->value->description(), "20");
}

TEST_F(SceneActionTest, ReadsWordsOfTheVocabulary) {
  EXPECT_EQ(value("climate-mode", "heat"), "1");
  EXPECT_EQ(value("locked", "yes"), "1");
  EXPECT_EQ(value("locked", "no"), "0");
}

TEST_F(SceneActionTest, ReadsTemperaturesAsTheyAreMeant) {
  EXPECT_EQ(value("temperature", "21.5"), "21.5");
  EXPECT_EQ(value("temperature", "68F"), "20");
  EXPECT_EQ(value("temperature", "68", false), "20");
  EXPECT_EQ(value("temperature", "20C", false), "20");
}

TEST_F(SceneActionTest, WritesTheUnitOfTheAccessory) {
  targetMetadata().units = "fahrenheit";
  targetMetadata().maximumValue = NDValue::floating(90);
  EXPECT_EQ(value("temperature", "20C"), "68");
  EXPECT_EQ(value("temperature", "68", false), "68");
}

TEST_F(SceneActionTest, RefusesWhatCanNotBeSet) {
  EXPECT_THAT(action({"Heat", "brightness", "20"}), IsBadInput("has no BRIGHTNESS that can be"));
  EXPECT_THAT(action({"Heat", "motion", "on"}), IsBadInput("has no MOTION that can be set"));
  EXPECT_THAT(action({"Heat", "brigtness", "20"}), IsBadInput("did you mean BRIGHTNESS?"));
  homes_[0].accessories[1].services.back().characteristics[1].properties.clear();
  EXPECT_THAT(action({"Heat", "temperature", "20"}), IsBadInput("has no TEMPERATURE"));
}

TEST_F(SceneActionTest, RefusesValuesThatDoNotFit) {
  EXPECT_THAT(action({"Heat", "temperature", "50"}),
              IsBadInput("50: TEMPERATURE goes from 5 to 35 here"));
  EXPECT_THAT(action({"Heat", "temperature", "-50"}), IsBadInput("goes from 5 to 35"));
  EXPECT_THAT(action({"Heat", "locked", "maybe"}), IsBadInput("maybe: LOCKED takes"));
  targetMetadata().format = "string";
  EXPECT_THAT(action({"Heat", "temperature", "20"}), IsBadInput("does not take it"));
}

TEST(ReadSettingTest, SplitsFromTheEnd) {
  const auto words = readSetting(" Floor lamp/Lamp  brightness 40% ", builtInVocabulary());
  ASSERT_TRUE(words);
  EXPECT_EQ(words->service, "Floor lamp/Lamp");
  EXPECT_EQ(words->attribute, "brightness");
  EXPECT_EQ(words->value, "40%");
}

TEST(ReadSettingTest, RefusesTooFewWords) {
  for (const char* text : {"", "  ", "40%", "brightness 40%", "Floor lamp/Lamp2 brightness"}) {
    EXPECT_THAT(readSetting(text, builtInVocabulary()),
                IsBadInput("a service, an attribute and a value"))
        << text;
  }
}

}  // namespace
}  // namespace nidus
