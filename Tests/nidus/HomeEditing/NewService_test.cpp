#include "nidus/HomeEditing/NewService.h"

#include <limits>

#include "HomePlatform/Metadata/VocabularyReader.h"
#include "nidus/HomeEditing/SampleHomes.h"

namespace nidus {
namespace {

const Vocabulary& vocabulary() {
  static const Vocabulary kVocabulary = builtInVocabulary();
  return kVocabulary;
}

/// The document of a home with nothing but that service's characteristics.
std::string textOfService(const Result<ServiceData>& service) {
  if (!service) return service.failure().message;
  HomeData home;
  home.name = "";
  home.accessories.resize(1);
  home.accessories[0].name = "";
  home.accessories[0].services = {*service};
  return textOf({home});
}

std::string serviceWith(const std::string& attribute) {
  return textOfService(makeService({"A", "light", "", {attribute}}, {}, vocabulary()));
}

struct AttributeCase {
  const char* attribute;
  std::vector<std::string> parts;
};

TEST(MakeServiceTest, SuitsTheVocabulary) {
  const std::string all = R"("properties": ["readable", "writable", "notifies"], )";
  const std::string read = R"("properties": ["readable", "notifies"], )";
  const AttributeCase table[] = {
      {"power", {all + R"("value": false, "metadata": {"format": "bool"}})"}},
      {"Brightness",
       {all + R"("value": 0, "metadata": {"format": "int", "units": "percentage", )" +
        R"("minimumValue": 0, "maximumValue": 100, "stepValue": 1}})"}},
      {"HUE",
       {R"("value": 0.0, "metadata": {"format": "float", "units": "arcdegrees", )",
        R"("maximumValue": 360.0)"}},
      {"color temperature", {R"("value": 140, )", R"("maximumValue": 500)"}},
      {"temperature",
       {R"(current-temperature", )" + read + R"("value": 0.0)", R"("minimumValue": -40.0)",
        R"(target-temperature", )" + all + R"("value": 5.0)", R"("maximumValue": 35.0)"}},
      {"locked",
       {R"(current-lock-state", )" + read +
            R"("value": 0, "metadata": {"format": "uint8", "minimumValue": 0, "maximumValue": 3)",
        R"(target-lock-state", )" + all +
            R"("value": 0, "metadata": {"format": "uint8", "minimumValue": 0, "maximumValue": 1)"}},
      {"motion", {read + R"("value": false, "metadata": {"format": "bool"}})"}},
      {"light_level", {read, R"("units": "lux", "minimumValue": 0.0, "maximumValue": 1e+05}})"}},
      {"identify", {R"("properties": ["writable"], "metadata": {"format": "bool"}})"}},
  };
  for (const AttributeCase& test : table) {
    SCOPED_TRACE(test.attribute);
    const std::string text = serviceWith(test.attribute);
    for (const std::string& part : test.parts) EXPECT_THAT(text, ::testing::HasSubstr(part));
  }
}

TEST(MakeServiceTest, KnowsValuesThatAreNoBytes) {
  CharacteristicEntry far{"FAR", "far", "far", "string", nullptr, false, false, {}};
  far.values = {{NDValue::text("NEAR"), NDValue::integer(7)},
                {NDValue::text("FAR"), NDValue::integer(700)}};
  CharacteristicEntry text{"WORDY", "wordy", "wordy", "string", nullptr, false, false, {}};
  text.values = {{NDValue::text("ONE"), NDValue::text("1")}};
  const Vocabulary own{{{"LIGHT", "light"}}, {far, text}, {}};
  const std::string made =
      textOfService(makeService({"A", "light", "", {"far", "wordy"}}, {}, own));
  EXPECT_THAT(
      made, ::testing::HasSubstr(R"("value": 7, "metadata": {"format": "int", "minimumValue": 7, )"
                                 R"("maximumValue": 700, "stepValue": 1}})"));
  EXPECT_THAT(made, ::testing::HasSubstr(R"("metadata": {"format": "string"}})"));
}

TEST(MakeServiceTest, NamesItsTypes) {
  const auto made = makeService({"Glow", "outlet", "Light", {}}, {}, vocabulary());
  ASSERT_TRUE(made);
  EXPECT_EQ(made->name, "Glow");
  EXPECT_EQ(made->serviceType, "com.corvane.nidus.service.outlet");
  EXPECT_EQ(made->associatedServiceType, "com.corvane.nidus.service.light");
  EXPECT_THAT(made->characteristics, ::testing::IsEmpty());
}

TEST(MakeServiceTest, TakesTheNextInstanceIDs) {
  const AccessoryData lamp = sampleHomes()[0].accessories[0];
  const auto made = makeService({"A", "light", "", {"power", "hue", "Power"}}, lamp, vocabulary());
  ASSERT_TRUE(made);
  EXPECT_EQ(made->instanceID, 9);
  ASSERT_EQ(made->characteristics.size(), 2U);
  EXPECT_EQ(made->characteristics[0].instanceID, 11);
  EXPECT_EQ(made->characteristics[1].instanceID, 12);
}

TEST(MakeServiceTest, FindsGapsBelowTheGreatestInstanceID) {
  AccessoryData lamp = sampleHomes()[0].accessories[0];
  lamp.services[0].instanceID = std::numeric_limits<std::int64_t>::max();
  const auto made = makeService({"A", "light", "", {}}, lamp, vocabulary());
  ASSERT_TRUE(made);
  EXPECT_EQ(made->instanceID, 1);
}

TEST(MakeServiceTest, RefusesUnknownWords) {
  const auto make = [](const ServiceWords& words) { return makeService(words, {}, vocabulary()); };
  EXPECT_THAT(make({"A", "lihgt", "", {}}), IsBadInput("lihgt: did you mean LIGHT?"));
  EXPECT_THAT(make({"A", "zeppelin", "", {}}), IsBadInput("see nidus vocabulary"));
  EXPECT_THAT(make({"A", "outlet", "lihgt", {}}), IsBadInput("did you mean LIGHT?"));
  EXPECT_THAT(make({"A", "light", "", {"brigtness"}}), IsBadInput("did you mean BRIGHTNESS?"));
  EXPECT_THAT(make({"A", "light", "", {"enabled"}}), IsBadInput("enabled: no accessory has"));
}

}  // namespace
}  // namespace nidus
