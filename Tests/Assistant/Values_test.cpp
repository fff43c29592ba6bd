#include "Assistant/Values.h"

#include <gtest/gtest.h>

#include <cmath>
#include <cstdint>
#include <limits>
#include <memory>
#include <string>
#include <utility>

namespace nidus {
namespace {

VAHAValueRef boolean(bool value) {
  auto made = VAHABooleanValue::booleanValue();
  made->setValue(value);
  return made;
}

VAHAValueRef integer(std::int64_t value) {
  auto made = VAHAIntegerValue::integerValue();
  made->setValue(value);
  return made;
}

VAHAValueRef floating(float value) {
  auto made = VAHAFloatValue::floatValue();
  made->setValue(value);
  return made;
}

VAHAValueRef text(NDString value) {
  auto made = VAHAStringValue::stringValue();
  made->setValue(std::move(value));
  return made;
}

VAHAActionRef actionWith(VAHAValueRef value) {
  auto action = std::make_shared<VAHAAction>();
  action->setValue(std::move(value));
  return action;
}

/// A value of a class that the plug-in does not know.
class OtherValue final : public VAHAValue {
 public:
  [[nodiscard]] bool isClassOf(const VAHAValue* other) const override {
    return dynamic_cast<const OtherValue*>(other) != nullptr;
  }
  [[nodiscard]] std::string description() const override { return "other"; }

 protected:
  void addValue(NDDictionary& /*dictionary*/) const override {}
};

/// A boolean that a host has refined.
class SwitchValue final : public VAHABooleanValue {
 public:
  [[nodiscard]] bool isClassOf(const VAHAValue* other) const override {
    return dynamic_cast<const SwitchValue*>(other) != nullptr;
  }
};

TEST(GetValueOfTypeTest, BoxesBoolean) {
  const NDValueRef value = getValueOfType("bool", actionWith(boolean(true)));
  ASSERT_TRUE(value);
  EXPECT_TRUE(value->isBoolean());
  EXPECT_TRUE(value->boolValue());
}

TEST(GetValueOfTypeTest, BoxesFloat) {
  const NDValueRef value = getValueOfType("float", actionWith(floating(21.5F)));
  ASSERT_TRUE(value);
  EXPECT_TRUE(value->isFloating());
  EXPECT_EQ(value->floatValue(), 21.5F);
}

TEST(GetValueOfTypeTest, BoxesInteger) {
  const NDValueRef value = getValueOfType("int", actionWith(integer(-7)));
  ASSERT_TRUE(value);
  EXPECT_TRUE(value->isInteger());
  EXPECT_EQ(value->integerValue(), -7);
}

TEST(GetValueOfTypeTest, GivesTheStringItself) {
  const NDString string = "HEAT";
  const NDValueRef value = getValueOfType("string", actionWith(text(string)));
  ASSERT_TRUE(value);
  EXPECT_EQ(value->stringValue().view().data(), string.view().data());
}

TEST(GetValueOfTypeTest, TakesDerivedClassForItsBase) {
  auto value = std::make_shared<SwitchValue>();
  value->setValue(true);
  const NDValueRef boxed = getValueOfType("bool", actionWith(value));
  ASSERT_TRUE(boxed);
  EXPECT_TRUE(boxed->isBoolean());
}

TEST(GetValueOfTypeTest, IgnoresTheType) {
  for (const char* type : {"bool", "int", "float", "string", "tlv8", "unknown"}) {
    SCOPED_TRACE(type);
    const NDValueRef value = getValueOfType(type, actionWith(integer(3)));
    ASSERT_TRUE(value);
    EXPECT_TRUE(value->isInteger());
  }
  EXPECT_TRUE(getValueOfType(nullptr, actionWith(integer(3))));
}

TEST(GetValueOfTypeTest, GivesNullForWhatHoldsNoValue) {
  EXPECT_FALSE(getValueOfType("int", nullptr));
  EXPECT_FALSE(getValueOfType("int", actionWith(nullptr)));
  EXPECT_FALSE(getValueOfType("int", actionWith(std::make_shared<OtherValue>())));
  EXPECT_FALSE(getValueOfType("string", actionWith(text(nullptr))));
}

TEST(SetValueTest, MakesBooleanOfBool) {
  const VAHAValueRef made = setValue(NDValue::integer(2), "bool", nullptr);
  const auto* value = dynamic_cast<const VAHABooleanValue*>(made.get());
  ASSERT_TRUE(value);
  EXPECT_TRUE(value->value());
  EXPECT_FALSE(value->units());
}

TEST(SetValueTest, MakesIntegerOfEachIntegerFormat) {
  for (const char* format : {"int", "uint8", "uint16", "uint32", "uint64"}) {
    SCOPED_TRACE(format);
    const VAHAValueRef made = setValue(NDValue::integer(255), format, "percentage");
    const auto* value = dynamic_cast<const VAHAIntegerValue*>(made.get());
    ASSERT_TRUE(value);
    EXPECT_EQ(value->value(), 255);
    EXPECT_EQ(value->units(), "percentage");
  }
}

TEST(SetValueTest, KeepsTheBitsOfWideIntegers) {
  const auto lowest = std::numeric_limits<std::int64_t>::min();
  const VAHAValueRef made = setValue(NDValue::integer(lowest), "uint64", nullptr);
  const auto* value = dynamic_cast<const VAHAIntegerValue*>(made.get());
  ASSERT_TRUE(value);
  EXPECT_EQ(value->value(), lowest);
}

TEST(SetValueTest, CutsFloatTowardZeroForInteger) {
  const VAHAValueRef made = setValue(NDValue::floating(-2.9F), "int", nullptr);
  const auto* value = dynamic_cast<const VAHAIntegerValue*>(made.get());
  ASSERT_TRUE(value);
  EXPECT_EQ(value->value(), -2);
}

TEST(SetValueTest, MakesFloatOfFloat) {
  const VAHAValueRef made = setValue(NDValue::integer(21), "float", "CELSIUS");
  const auto* value = dynamic_cast<const VAHAFloatValue*>(made.get());
  ASSERT_TRUE(value);
  EXPECT_EQ(value->value(), 21.0F);
  EXPECT_EQ(value->units(), "CELSIUS");
}

TEST(SetValueTest, MakesStringOfText) {
  const VAHAValueRef made = setValue(NDValue::text("HEAT"), "string", "words");
  const auto* value = dynamic_cast<const VAHAStringValue*>(made.get());
  ASSERT_TRUE(value);
  EXPECT_EQ(value->value(), "HEAT");
  EXPECT_EQ(value->units(), "words");
}

TEST(SetValueTest, WritesNumbersAsTextForString) {
  const std::pair<NDValueRef, const char*> cases[] = {{NDValue::boolean(true), "1"},
                                                      {NDValue::boolean(false), "0"},
                                                      {NDValue::integer(-3), "-3"},
                                                      {NDValue::floating(72.0F), "72"},
                                                      {NDValue::floating(0.1F), "0.1"}};
  for (const auto& [number, expected] : cases) {
    SCOPED_TRACE(expected);
    const VAHAValueRef made = setValue(number, "string", nullptr);
    EXPECT_EQ(dynamic_cast<const VAHAStringValue&>(*made).value(), expected);
  }
}

TEST(SetValueTest, ReadsTextAsNothingForNumbers) {
  const NDValueRef word = NDValue::text("7");
  EXPECT_FALSE(dynamic_cast<const VAHABooleanValue&>(*setValue(word, "bool", nullptr)).value());
  EXPECT_EQ(dynamic_cast<const VAHAIntegerValue&>(*setValue(word, "int", nullptr)).value(), 0);
  EXPECT_EQ(dynamic_cast<const VAHAFloatValue&>(*setValue(word, "float", nullptr)).value(), 0.0F);
}

TEST(SetValueTest, MakesValueObjectsOfNull) {
  EXPECT_FALSE(dynamic_cast<const VAHABooleanValue&>(*setValue(nullptr, "bool", "u")).value());
  EXPECT_EQ(dynamic_cast<const VAHAIntegerValue&>(*setValue(nullptr, "uint8", "u")).value(), 0);
  EXPECT_EQ(dynamic_cast<const VAHAFloatValue&>(*setValue(nullptr, "float", "u")).value(), 0.0F);
  const VAHAValueRef none = setValue(nullptr, "string", "u");
  EXPECT_FALSE(dynamic_cast<const VAHAStringValue&>(*none).value());
  EXPECT_EQ(none->units(), "u");
}

TEST(SetValueTest, GivesNullForOtherFormats) {
  for (const char* format : {"array", "dictionary", "data", "tlv8", "Bool", "integer", ""}) {
    SCOPED_TRACE(format);
    EXPECT_FALSE(setValue(NDValue::integer(1), format, "percentage"));
  }
  EXPECT_FALSE(setValue(NDValue::integer(1), nullptr, "percentage"));
}

TEST(IsAttributeValueEqualTest, ComparesWithinOneClass) {
  struct Case {
    const char* label;
    VAHAValueRef a;
    VAHAValueRef b;
    bool areEqual;
  };
  const float nan = std::numeric_limits<float>::quiet_NaN();
  const Case cases[] = {
      {"true and true", boolean(true), boolean(true), true},
      {"true and false", boolean(true), boolean(false), false},
      {"equal integers", integer(5), integer(5), true},
      {"other integers", integer(5), integer(6), false},
      {"equal floats", floating(21.5F), floating(21.5F), true},
      {"neighbouring floats", floating(21.5F), floating(21.500002F), false},
      {"both zeros", floating(0.0F), floating(-0.0F), true},
      {"not a number", floating(nan), floating(nan), false},
      {"equal strings", text("HEAT"), text("HEAT"), true},
      {"other letter case", text("HEAT"), text("Heat"), false},
      {"string and none", text("HEAT"), text(nullptr), false},
  };
  for (const Case& test : cases) {
    SCOPED_TRACE(test.label);
    EXPECT_EQ(isAttributeValueEqual(test.a, test.b), test.areEqual);
    EXPECT_EQ(isAttributeValueEqual(test.b, test.a), test.areEqual);
  }
}

TEST(IsAttributeValueEqualTest, TellsClassesApart) {
  const VAHAValueRef values[] = {boolean(true), integer(1), floating(1.0F), text("1")};
  for (const auto& a : values) {
    for (const auto& b : values) {
      EXPECT_EQ(isAttributeValueEqual(a, b), a == b) << a->description() << b->description();
    }
  }
}

TEST(IsAttributeValueEqualTest, IsFalseForNull) {
  EXPECT_FALSE(isAttributeValueEqual(nullptr, integer(0)));
  EXPECT_FALSE(isAttributeValueEqual(integer(0), nullptr));
  EXPECT_FALSE(isAttributeValueEqual(nullptr, nullptr));
}

TEST(IsAttributeValueEqualTest, AcceptsDerivedClassOnTheLeftOnly) {
  auto derived = std::make_shared<SwitchValue>();
  derived->setValue(true);
  EXPECT_TRUE(isAttributeValueEqual(derived, boolean(true)));
  EXPECT_FALSE(isAttributeValueEqual(boolean(true), derived));
}

TEST(IsAttributeValueEqualTest, IsFalseForUnknownClasses) {
  const auto other = std::make_shared<OtherValue>();
  EXPECT_FALSE(isAttributeValueEqual(other, other));
}

TEST(IsAttributeValueEqualTest, LeavesUnitsAside) {
  auto celsius = VAHAFloatValue::floatValue();
  celsius->setValue(20);
  celsius->setUnits("CELSIUS");
  EXPECT_TRUE(isAttributeValueEqual(celsius, floating(20)));
}

TEST(ConvertValueTest, ConvertsBetweenTheTwoScales) {
  const NDValueRef warm = convertValue(NDValue::integer(20), "celsius", "fahrenheit");
  EXPECT_TRUE(warm->isFloating());
  EXPECT_EQ(warm->floatValue(), 68.0F);
  const NDValueRef hot = convertValue(NDValue::integer(212), "fahrenheit", "celsius");
  EXPECT_TRUE(hot->isFloating());
  EXPECT_EQ(hot->floatValue(), 100.0F);
}

TEST(ConvertValueTest, GivesTheSameObjectForOtherUnits) {
  const NDString none;
  const std::pair<NDString, NDString> cases[] = {{"celsius", "celsius"},
                                                 {"fahrenheit", "fahrenheit"},
                                                 {"percentage", "fahrenheit"},
                                                 {"celsius", "percentage"},
                                                 {none, "fahrenheit"},
                                                 {"celsius", none},
                                                 {none, none},
                                                 {"Celsius", "fahrenheit"},
                                                 {"fahrenheit", "CELSIUS"},
                                                 {"fahrenheit", "percentage"},
                                                 {"fahrenheit", none},
                                                 {"percentage", "percentage"}};
  for (const auto& [from, to] : cases) {
    SCOPED_TRACE(from.str() + " to " + to.str());
    const NDValueRef value = NDValue::integer(20);
    EXPECT_EQ(convertValue(value, from, to), value);
  }
}

TEST(ConvertValueTest, ReadsNullAsZero) {
  EXPECT_EQ(convertValue(nullptr, "celsius", "fahrenheit")->floatValue(), 32.0F);
  EXPECT_EQ(convertValue(nullptr, "fahrenheit", "celsius")->floatValue(), -17.777779F);
  EXPECT_FALSE(convertValue(nullptr, "celsius", "celsius"));
}

TEST(FahrenheitToCelsiusTest, FixesTheLastBit) {
  const std::pair<float, float> cases[] = {{32.0F, 0.0F},
                                           {212.0F, 100.0F},
                                           {-40.0F, -40.0F},
                                           {68.0F, 20.0F},
                                           {72.0F, 22.22222137451172F},
                                           {100.0F, 37.77777862548828F}};
  for (const auto& [fahrenheit, celsius] : cases) {
    EXPECT_EQ(fahrenheitToCelsius(fahrenheit), celsius) << fahrenheit;
  }
}

TEST(CelsiusToFahrenheitTest, FixesTheLastBit) {
  const std::pair<float, float> cases[] = {{0.0F, 32.0F},
                                           {20.0F, 68.0F},
                                           {22.5F, 72.5F},
                                           {21.5F, 70.69999694824219F},
                                           {37.0F, 98.5999984741211F}};
  for (const auto& [celsius, fahrenheit] : cases) {
    EXPECT_EQ(celsiusToFahrenheit(celsius), fahrenheit) << celsius;
  }
}

TEST(CelsiusToFahrenheitTest, ComesBackToSeventyTwo) {
  EXPECT_EQ(celsiusToFahrenheit(fahrenheitToCelsius(72.0F)), 72.0F);
}

// What the steps give when each of them is rounded to 64 bits, one after the other. A fused
// multiply-add, or another order of the steps, differs from it somewhere in this range.
TEST(TemperatureTest, RoundsEachStepByItself) {
  for (int tenths = -1000; tenths <= 3000; ++tenths) {
    const float degrees = static_cast<float>(tenths) / 10.0F;
    volatile double celsius = static_cast<double>(degrees) - 32.0;
    celsius = celsius * 5.0;
    celsius = celsius / 9.0;
    volatile double fahrenheit = static_cast<double>(degrees) * 1.8;
    fahrenheit = fahrenheit + 32.0;
    ASSERT_EQ(fahrenheitToCelsius(degrees), static_cast<float>(celsius)) << degrees;
    ASSERT_EQ(celsiusToFahrenheit(degrees), static_cast<float>(fahrenheit)) << degrees;
  }
}

TEST(TemperatureTest, PassesExtremesThrough) {
  const float infinity = std::numeric_limits<float>::infinity();
  EXPECT_EQ(celsiusToFahrenheit(infinity), infinity);
  EXPECT_EQ(fahrenheitToCelsius(-infinity), -infinity);
  EXPECT_TRUE(std::isnan(celsiusToFahrenheit(std::numeric_limits<float>::quiet_NaN())));
}

}  // namespace
}  // namespace nidus
