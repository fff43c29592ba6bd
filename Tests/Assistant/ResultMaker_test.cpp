#include "Assistant/ResultMaker.h"

#include <gmock/gmock.h>

#include <cmath>
#include <string>
#include <vector>

#include "Assistant/CommandTest.h"
#include "Support/TestTypes.h"

namespace nidus {
namespace {

using ::testing::ElementsAre;

class ResultMakerTest : public CommandTest {
 protected:
  using Values = std::vector<VAHAValueRef>;

  /// What one maker tells about services with one characteristic each.
  static Values toldValues(const char* attribute, const std::vector<CharacteristicSpec>& specs) {
    ResultMaker maker(makeAction({.type = "GET", .attribute = attribute}), nullptr);
    HomeBuilder builder("Cottage");
    for (const CharacteristicSpec& spec : specs) builder.light("Lamp", {spec});
    Values values;
    for (const auto& accessory : builder.build()->accessories()) {
      const auto result = maker.make(VAHAActionOutcomeSUCCESSValue, accessory->services()[0]);
      values.push_back(result->resultValue());
    }
    return values;
  }
  static std::vector<std::string> texts(const Values& values) {
    std::vector<std::string> texts;
    for (const VAHAValueRef& value : values) texts.push_back(description(value));
    return texts;
  }
};

TEST_F(ResultMakerTest, NeighboursOfOneValueShareIt) {
  const Values told = toldValues("BRIGHTNESS", {brightness(40), brightness(40), brightness(41)});
  EXPECT_EQ(told[0], told[1]);
  EXPECT_THAT(texts(told), ElementsAre("40", "40", "41"));
}

TEST_F(ResultMakerTest, ValuesThatComeBackAreTold) {
  EXPECT_THAT(texts(toldValues("POWER", {power(true), power(false), power(false), power(true)})),
              ElementsAre("1", "0", "0", "1"));
}

TEST_F(ResultMakerTest, NullBetweenValuesIsTold) {
  const CharacteristicSpec none = CharacteristicSpec(kBrightness).value(NDValueRef());
  EXPECT_THAT(texts(toldValues("BRIGHTNESS", {none, brightness(40), none, brightness(40)})),
              ElementsAre("0", "40", "0", "40"));
}

TEST_F(ResultMakerTest, FloatsThatAreEqualAreToldApart) {
  const Values told =
      toldValues("TEMPERATURE", {currentTemperature(0.0F), currentTemperature(-0.0F)});
  EXPECT_FALSE(std::signbit(dynamic_cast<const VAHAFloatValue&>(*told[0]).value()));
  EXPECT_TRUE(std::signbit(dynamic_cast<const VAHAFloatValue&>(*told[1]).value()));
}

TEST_F(ResultMakerTest, BooleansAreNoNumbers) {
  const auto mode = [](auto value) { return CharacteristicSpec(kCurrentClimateMode).value(value); };
  EXPECT_THAT(texts(toldValues("CLIMATE_MODE", {mode(1), mode(true), mode(1)})),
              ElementsAre("HEAT", "1", "HEAT"));
}

}  // namespace
}  // namespace nidus
