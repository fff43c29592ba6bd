#include "Support/TestMetadata.h"

#include <array>
#include <cstdint>
#include <utility>

#include "Support/TestTypes.h"

namespace nidus {
namespace {

using Pair = std::pair<std::string_view, std::string_view>;

constexpr std::array kServices = {Pair("LIGHT", kLightService), Pair("OUTLET", kOutletService),
                                  Pair("THERMOSTAT", kThermostatService)};
constexpr std::array kUnits = {Pair("CELSIUS", "celsius"), Pair("FAHRENHEIT", "fahrenheit"),
                               Pair("PERCENTAGE", "percentage")};

/// An attribute; what it does not have is empty.
struct Attribute {
  std::string_view name;
  std::string_view read;
  std::string_view write;
  std::string_view valueType;
  std::string_view unit;
  bool isLocalized = false;
};

constexpr std::array kAttributes = {
    Attribute{"POWER", kPower, kPower, "bool", ""},
    Attribute{"BRIGHTNESS", kBrightness, kBrightness, "int", "percentage"},
    Attribute{"TEMPERATURE", kCurrentTemperature, kTargetTemperature, "float", "celsius", true},
    Attribute{"CLIMATE_MODE", kCurrentClimateMode, kTargetClimateMode, "string", ""},
    Attribute{"IDENTIFY", "", kIdentify, "bool", ""},
    Attribute{"ENABLED", "", "", "bool", ""}};

/// The climate modes, whose platform values are their places.
constexpr std::array<std::string_view, 4> kModes = {"OFF", "HEAT", "COOL", "AUTO"};

NDString textOf(std::string_view text) { return text.empty() ? NDString() : NDString(text); }

template <class Pairs>
NDString secondOf(const Pairs& pairs, const NDString& first) {
  for (const Pair& pair : pairs) {
    if (first == pair.first) return pair.second;
  }
  return nullptr;
}

template <class Pairs>
NDString firstOf(const Pairs& pairs, const NDString& second) {
  for (const Pair& pair : pairs) {
    if (second == pair.second) return pair.first;
  }
  return nullptr;
}

/// The attribute of that name or type; one without any field when there is none.
Attribute attributeOf(const NDString& name) {
  if (!name || name == "") return {};
  for (const Attribute& attribute : kAttributes) {
    if (name == attribute.name || name == attribute.read || name == attribute.write) {
      return attribute;
    }
  }
  return {};
}

}  // namespace

NDString TestMetadata::mapFromAssistantServiceName(const NDString& name) const {
  return secondOf(kServices, name);
}

NDString TestMetadata::mapToAssistantServiceName(const NDString& type) const {
  return firstOf(kServices, type);
}

NDString TestMetadata::mapToAssistantCharacteristicName(const NDString& type) const {
  return textOf(attributeOf(type).name);
}

NDString TestMetadata::mapReadCharcteristicFromAssistantName(const NDString& name) const {
  return textOf(attributeOf(name).read);
}

NDString TestMetadata::mapWriteCharcteristicFromAssistantName(const NDString& name) const {
  return textOf(attributeOf(name).write);
}

NDString TestMetadata::mapCharacteristicValueType(const NDString& name) const {
  return textOf(attributeOf(name).valueType);
}

NDString TestMetadata::mapFromAssistantUnitName(const NDString& name) const {
  return secondOf(kUnits, name);
}

NDString TestMetadata::mapToAssistantUnitName(const NDString& unit) const {
  return firstOf(kUnits, unit);
}

NDString TestMetadata::characteristicValueUnit(const NDString& type) const {
  return textOf(attributeOf(type).unit);
}

bool TestMetadata::supportsLocalization(const NDString& type) const {
  return attributeOf(type).isLocalized;
}

NDValueRef TestMetadata::mapFromAssistantCharacteristicValue_name(const NDValueRef& value,
                                                                  const NDString& name) const {
  if (!value || attributeOf(name).name != "CLIMATE_MODE") return value;
  for (std::size_t place = 0; place < kModes.size(); ++place) {
    if (value->stringValue() == kModes[place]) {
      return NDValue::integer(static_cast<std::int64_t>(place));
    }
  }
  return value;
}

NDValueRef TestMetadata::mapToAssistantCharacteristicValue_name(const NDValueRef& value,
                                                                const NDString& name) const {
  if (!value || attributeOf(name).name != "CLIMATE_MODE") return value;
  if (value->isText() || value->isBoolean()) return value;
  const auto place = static_cast<std::size_t>(value->integerValue());
  return place < kModes.size() ? NDValue::text(kModes[place]) : value;
}

}  // namespace nidus
