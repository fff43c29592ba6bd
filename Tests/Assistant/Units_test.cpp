#include "Assistant/Units.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>
#include <string_view>
#include <utility>

#include "Assistant/CommandTest.h"
#include "Support/TestTypes.h"

namespace nidus {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

constexpr bool kMetric = true;
constexpr bool kNotMetric = false;

/// Each locale has a process of its own, because a process asks for its locale once.
class UnitsTest : public CommandTest {};

TEST_F(UnitsTest, AsksTheLocale) {
  inProcessWithLocale(kMetric, [] { EXPECT_TRUE(isMetricLocale()); });
  inProcessWithLocale(kNotMetric, [] { EXPECT_FALSE(isMetricLocale()); });
  inProcessWithLocale(std::nullopt, [] { EXPECT_FALSE(isMetricLocale()); });
}

TEST_F(UnitsTest, AsksTheLocaleOnce) {
  inProcessWithLocale(kMetric, [this] {
    EXPECT_TRUE(isMetricLocale());
    setLocale(kNotMetric);
    EXPECT_TRUE(isMetricLocale());
  });
}

TEST_F(UnitsTest, GivesTheLocalesTemperatureUnit) {
  inProcessWithLocale(kMetric, [] {
    EXPECT_EQ(getLocaleUnits("celsius"), "celsius");
    EXPECT_EQ(getLocaleUnits("fahrenheit"), "celsius");
  });
  inProcessWithLocale(kNotMetric, [] {
    EXPECT_EQ(getLocaleUnits("celsius"), "fahrenheit");
    EXPECT_EQ(getLocaleUnits("fahrenheit"), "fahrenheit");
  });
}

TEST_F(UnitsTest, LeavesOtherUnitsAlone) {
  inProcessWithLocale(kNotMetric, [] {
    EXPECT_EQ(getLocaleUnits("percentage"), "percentage");
    EXPECT_EQ(getLocaleUnits("Celsius"), "Celsius");
    EXPECT_EQ(getLocaleUnits(""), "");
    EXPECT_FALSE(getLocaleUnits(nullptr));
  });
}

TEST_F(UnitsTest, ReportsInTheLocalesUnitWithoutRequest) {
  inProcessWithLocale(
      kNotMetric, [] { EXPECT_EQ(getReportingUnits(nullptr, kCurrentTemperature), "fahrenheit"); });
  inProcessWithLocale(
      kMetric, [] { EXPECT_EQ(getReportingUnits(nullptr, kCurrentTemperature), "celsius"); });
}

TEST_F(UnitsTest, ReportsInTheRequestedUnit) {
  inProcessWithLocale(kNotMetric, [] {
    EXPECT_EQ(getReportingUnits("celsius", kCurrentTemperature), "celsius");
    EXPECT_EQ(getReportingUnits("fahrenheit", kCurrentTemperature), "fahrenheit");
    EXPECT_EQ(getReportingUnits("percentage", kCurrentTemperature), "percentage");
  });
}

TEST_F(UnitsTest, ReportsInTheTypesUnitWithoutLocalization) {
  inProcessWithLocale(kNotMetric, [] {
    EXPECT_EQ(getReportingUnits(nullptr, kBrightness), "percentage");
    EXPECT_EQ(getReportingUnits("celsius", kBrightness), "percentage");
    EXPECT_FALSE(getReportingUnits("celsius", kPower));
    EXPECT_FALSE(getReportingUnits("celsius", kUnmapped));
    EXPECT_FALSE(getReportingUnits("celsius", nullptr));
  });
}

TEST_F(UnitsTest, SetTakesFahrenheitOffTheMetricSystem) {
  inProcessWithLocale(kNotMetric, [this] {
    const NDValueRef value = adjustSetValue(NDValue::integer(72), "float", nullptr, "TEMPERATURE");
    EXPECT_TRUE(value->isFloating());
    EXPECT_EQ(value->floatValue(), 22.222221F);
    EXPECT_THAT(
        log(),
        ElementsAre("6 adjustSet: Attribute TEMPERATURE value 72  locale-adjusted to 22.222221"));
  });
}

TEST_F(UnitsTest, SetTakesOtherUnitsForFahrenheit) {
  inProcessWithLocale(kNotMetric, [] {
    for (const char* units : {"FAHRENHEIT", "celsius", "PERCENTAGE", ""}) {
      EXPECT_EQ(adjustSetValue(NDValue::integer(212), nullptr, units, "TEMPERATURE")->floatValue(),
                100.0F);
    }
    EXPECT_EQ(adjustSetValue(nullptr, nullptr, nullptr, "TEMPERATURE")->floatValue(), -17.777779F);
  });
}

TEST_F(UnitsTest, SetKeepsCelsius) {
  inProcessWithLocale(kNotMetric, [this] {
    const NDValueRef value = NDValue::integer(72);
    EXPECT_EQ(adjustSetValue(value, "float", "CELSIUS", "TEMPERATURE"), value);
    EXPECT_THAT(log(), IsEmpty());
  });
}

TEST_F(UnitsTest, SetKeepsValuesInTheMetricSystem) {
  inProcessWithLocale(kMetric, [this] {
    const NDValueRef value = NDValue::integer(72);
    EXPECT_EQ(adjustSetValue(value, "float", nullptr, "TEMPERATURE"), value);
    EXPECT_EQ(adjustSetValue(value, "float", "FAHRENHEIT", "TEMPERATURE"), value);
    EXPECT_THAT(log(), IsEmpty());
  });
}

// The type follows the user's unit system whatever name it goes by, but only the attribute's own
// name is a temperature here.
TEST_F(UnitsTest, SetKeepsOtherLocalizedAttributes) {
  inProcessWithLocale(kNotMetric, [] {
    const NDValueRef value = NDValue::integer(72);
    EXPECT_EQ(adjustSetValue(value, "float", nullptr, kTargetTemperature), value);
  });
}

TEST_F(UnitsTest, GetGivesFahrenheitOffTheMetricSystem) {
  inProcessWithLocale(kNotMetric, [this] {
    const NDValueRef value =
        adjustGetValue(NDValue::floating(22.5F), "float", nullptr, "TEMPERATURE");
    EXPECT_EQ(value->floatValue(), 72.5F);
    EXPECT_THAT(log(),
                ElementsAre("6 adjustGet: Characteristic " + std::string(kTargetTemperature) +
                            " value 22.5  locale-adjusted to 72.5"));
  });
}

TEST_F(UnitsTest, GetConvertsByTheTypeToo) {
  inProcessWithLocale(kNotMetric, [] {
    const NDValueRef value =
        adjustGetValue(NDValue::integer(20), "float", nullptr, kCurrentTemperature);
    EXPECT_TRUE(value->isFloating());
    EXPECT_EQ(value->floatValue(), 68.0F);
  });
}

TEST_F(UnitsTest, GetKeepsCelsius) {
  inProcessWithLocale(kNotMetric, [this] {
    const NDValueRef value = NDValue::floating(22.5F);
    EXPECT_EQ(adjustGetValue(value, "float", "CELSIUS", "TEMPERATURE"), value);
    EXPECT_THAT(log(), IsEmpty());
  });
}

TEST_F(UnitsTest, GetKeepsValuesInTheMetricSystem) {
  inProcessWithLocale(kMetric, [this] {
    const NDValueRef value = NDValue::floating(22.5F);
    EXPECT_EQ(adjustGetValue(value, "float", nullptr, "TEMPERATURE"), value);
    EXPECT_THAT(log(), IsEmpty());
  });
}

TEST_F(UnitsTest, LogsNothingBelowItsLevel) {
  inProcessWithLocale(kNotMetric, [this] {
    logLevel(5);
    EXPECT_EQ(adjustGetValue(NDValue::integer(20), nullptr, nullptr, "TEMPERATURE")->floatValue(),
              68.0F);
    EXPECT_EQ(adjustSetValue(NDValue::integer(68), nullptr, nullptr, "TEMPERATURE")->floatValue(),
              20.0F);
    EXPECT_THAT(log(), IsEmpty());
  });
}

TEST_F(UnitsTest, MapsValuesWithoutLocalization) {
  inProcessWithLocale(kNotMetric, [] {
    const NDValueRef heat = adjustSetValue(NDValue::text("HEAT"), nullptr, nullptr, "CLIMATE_MODE");
    EXPECT_EQ(description(heat), "1");
    EXPECT_EQ(description(adjustGetValue(heat, nullptr, nullptr, "CLIMATE_MODE")), "HEAT");
    const NDValueRef level = NDValue::integer(40);
    EXPECT_EQ(adjustSetValue(level, nullptr, nullptr, "BRIGHTNESS"), level);
    EXPECT_EQ(adjustGetValue(level, nullptr, nullptr, kBrightness), level);
    EXPECT_FALSE(adjustSetValue(nullptr, nullptr, nullptr, "BRIGHTNESS"));
    EXPECT_FALSE(adjustGetValue(nullptr, nullptr, nullptr, nullptr));
  });
}

}  // namespace
}  // namespace nidus
