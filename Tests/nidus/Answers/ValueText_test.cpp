#include "nidus/Answers/ValueText.h"

#include <gtest/gtest.h>

#include "HomePlatform/Metadata/VocabularyReader.h"

namespace nidus {
namespace {

NDDictionary valueOf(const char* kind, NDDictionaryValue content, const char* units = nullptr) {
  NDDictionary value;
  value.set(kind, std::move(content));
  value.setIfPresent("units", units);
  return value;
}
NDDictionary boolean(bool value) { return valueOf("boolean", NDDictionaryValue(value)); }
NDDictionary integer(std::int64_t value, const char* units = nullptr) {
  return valueOf("integer", NDDictionaryValue(value), units);
}
NDDictionary floating(float value, const char* units = nullptr) {
  return valueOf("float", NDDictionaryValue(value), units);
}
NDDictionary text(const char* value) {
  return valueOf("string", NDDictionaryValue(NDString(value)));
}

struct ValueTextCase {
  const char* label;
  NDDictionary value;
  const char* attribute;
  const char* text;
};

TEST(ValueTextTest, SaysValuesAsPeopleDo) {
  const ValueTextCase table[] = {
      {"none", {}, "POWER", ""},
      {"switched on", boolean(true), "POWER", "on"},
      {"switched off", boolean(false), "MUTE", "off"},
      {"it is so", boolean(true), "LOCKED", "yes"},
      {"it is not so", boolean(false), "MOTION", "no"},
      {"units of its own", integer(65, "PERCENTAGE"), "BRIGHTNESS", "65 %"},
      {"units of the attribute", integer(65), "BRIGHTNESS", "65 %"},
      {"Celsius", floating(21.5F, "CELSIUS"), "TEMPERATURE", "21.5 °C"},
      {"Fahrenheit", floating(72, "FAHRENHEIT"), "TEMPERATURE", "72 °F"},
      {"temperature without units", floating(21.5F), "TEMPERATURE", "21.5"},
      {"degrees of an angle", floating(30), "HUE", "30°"},
      {"unit without a sign", integer(153, "MIRED"), "COLOR_TEMPERATURE", "153 mired"},
      {"light", floating(120.25F), "LIGHT_LEVEL", "120.25 lx"},
      {"unknown attribute", integer(-3), "COSINESS", "-3"},
      {"word of the vocabulary", text("HEAT"), "CLIMATE_MODE", "heat"},
      {"word of somebody else", text("Eco\x1b"), "CLIMATE_MODE", "Eco\\x1b"},
      {"text that is null", text(nullptr), "CLIMATE_MODE", "unknown"},
      {"unit of somebody else", integer(1, "\x1b"), "BRIGHTNESS", "1 \\x1b"},
  };
  const Vocabulary vocabulary = builtInVocabulary();
  for (const ValueTextCase& value : table) {
    SCOPED_TRACE(value.label);
    EXPECT_EQ(valueText(value.value, value.attribute, vocabulary), value.text);
  }
}

TEST(ValueTextTest, GivesLimitsTheUnitOfTheDevice) {
  const Vocabulary vocabulary = builtInVocabulary();
  EXPECT_EQ(limitText(floating(0.5F), "TEMPERATURE", vocabulary), "0.5 °C");
  EXPECT_EQ(limitText(floating(45, "fahrenheit"), "TEMPERATURE", vocabulary), "45 °F");
  EXPECT_EQ(limitText(integer(100, "percentage"), "BRIGHTNESS", vocabulary), "100 %");
}

struct NumberCase {
  float number;
  const char* text;
};

TEST(ShortNumberTextTest, KeepsTwoDigitsBehindThePoint) {
  const NumberCase table[] = {
      {0, "0"},         {22.222221F, "22.22"},   {72, "72"},
      {100, "100"},     {-0.5F, "-0.5"},         {19.999F, "20"},
      {0.01F, "0.01"},  {0.004F, "0.004"},       {-0.001F, "-0.001"},
      {1e30F, "1e+30"}, {9999999.0F, "9999999"},
  };
  for (const NumberCase& number : table) {
    EXPECT_EQ(shortNumberText(number.number), number.text);
  }
}

}  // namespace
}  // namespace nidus
