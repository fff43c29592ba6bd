#include "Assistant/Values.h"

#include <algorithm>
#include <array>
#include <memory>
#include <utility>

#include "PlatformModel/Home/NDCharacteristicConstants.h"
#include "PlatformModel/System/NDNull.h"

namespace nidus {
namespace {

constexpr std::array kIntegerFormats = {
    NDCharacteristicMetadataFormatInt,    NDCharacteristicMetadataFormatUInt8,
    NDCharacteristicMetadataFormatUInt16, NDCharacteristicMetadataFormatUInt32,
    NDCharacteristicMetadataFormatUInt64,
};

bool isIntegerFormat(const NDString& format) {
  return std::any_of(kIntegerFormats.begin(), kIntegerFormats.end(),
                     [&format](std::string_view name) { return format == name; });
}

NDString textOf(const NDValueRef& value) {
  if (!value) return nullptr;
  return value->isText() ? value->stringValue() : NDString(value->description());
}

std::shared_ptr<VAHAValue> makeValue(const NDValueRef& value, const NDString& format) {
  if (format == NDCharacteristicMetadataFormatBool) {
    auto made = VAHABooleanValue::booleanValue();
    made->setValue(property(value, &NDValue::boolValue));
    return made;
  }
  if (isIntegerFormat(format)) {
    auto made = VAHAIntegerValue::integerValue();
    made->setValue(property(value, &NDValue::integerValue));
    return made;
  }
  if (format == NDCharacteristicMetadataFormatFloat) {
    auto made = VAHAFloatValue::floatValue();
    made->setValue(property(value, &NDValue::floatValue));
    return made;
  }
  if (format == NDCharacteristicMetadataFormatString) {
    auto made = VAHAStringValue::stringValue();
    made->setValue(textOf(value));
    return made;
  }
  return nullptr;
}

/// Says whether both are of `Class` and hold the same value.
template <class Class>
bool holdSameValue(const VAHAValue& a, const VAHAValue& b) {
  const auto* first = dynamic_cast<const Class*>(&a);
  const auto* second = dynamic_cast<const Class*>(&b);
  return first && second && first->value() == second->value();
}

}  // namespace

NDValueRef getValueOfType(const NDString& /*type*/, const VAHAActionRef& action) {
  const VAHAValue* value = property(action, &VAHAAction::value).get();
  if (const auto* boolean = dynamic_cast<const VAHABooleanValue*>(value)) {
    return NDValue::boolean(boolean->value());
  }
  if (const auto* floating = dynamic_cast<const VAHAFloatValue*>(value)) {
    return NDValue::floating(floating->value());
  }
  if (const auto* integer = dynamic_cast<const VAHAIntegerValue*>(value)) {
    return NDValue::integer(integer->value());
  }
  const auto* text = dynamic_cast<const VAHAStringValue*>(value);
  return text && text->value() ? NDValue::text(text->value()) : nullptr;
}

VAHAValueRef setValue(const NDValueRef& value, const NDString& format, const NDString& units) {
  auto made = makeValue(value, format);
  if (made) made->setUnits(units);
  return made;
}

bool isAttributeValueEqual(const VAHAValueRef& a, const VAHAValueRef& b) {
  if (!b || !b->isClassOf(a.get())) return false;
  return holdSameValue<VAHABooleanValue>(*a, *b) || holdSameValue<VAHAIntegerValue>(*a, *b) ||
         holdSameValue<VAHAFloatValue>(*a, *b) || holdSameValue<VAHAStringValue>(*a, *b);
}

NDValueRef convertValue(const NDValueRef& value, const NDString& fromUnits,
                        const NDString& toUnits) {
  if (fromUnits == NDCharacteristicMetadataUnitsCelsius &&
      toUnits == NDCharacteristicMetadataUnitsFahrenheit) {
    return NDValue::floating(celsiusToFahrenheit(property(value, &NDValue::floatValue)));
  }
  if (fromUnits == NDCharacteristicMetadataUnitsFahrenheit &&
      toUnits == NDCharacteristicMetadataUnitsCelsius) {
    return NDValue::floating(fahrenheitToCelsius(property(value, &NDValue::floatValue)));
  }
  return value;
}

// The two directions are not mirror images of each other. The order of their steps decides the last
// bit of every temperature that is spoken or written, so neither is to be rearranged.

float fahrenheitToCelsius(float fahrenheit) {
  return static_cast<float>((static_cast<double>(fahrenheit) + -32.0) * 5.0 / 9.0);
}

float celsiusToFahrenheit(float celsius) {
  return static_cast<float>(static_cast<double>(celsius) * 1.8 + 32.0);
}

}  // namespace nidus
