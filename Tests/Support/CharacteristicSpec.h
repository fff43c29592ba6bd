#pragma once

#include <cstdint>
#include <string_view>
#include <utility>
#include <vector>

#include "PlatformModel/System/NDString.h"
#include "PlatformModel/System/NDValue.h"

namespace nidus {

/// Says what a characteristic of a test home is like. Unless said otherwise it can be read and
/// written, has metadata without any field, and no value.
///
///     CharacteristicSpec(kBrightness).value(40).format("int").limits(0, 100, 1)
class CharacteristicSpec {
 public:
  explicit CharacteristicSpec(std::string_view type) : type_(type) {}

  /// The cached value, which the device has too.
  CharacteristicSpec& value(NDValueRef value) {
    deviceValue_ = value;
    value_ = std::move(value);
    return *this;
  }
  CharacteristicSpec& value(bool value) { return this->value(NDValue::boolean(value)); }
  CharacteristicSpec& value(int value) { return this->value(NDValue::integer(value)); }
  CharacteristicSpec& value(float value) { return this->value(NDValue::floating(value)); }
  CharacteristicSpec& value(const char* value) { return this->value(NDValue::text(value)); }

  /// What the device will answer when it is read.
  CharacteristicSpec& deviceValue(NDValueRef value) {
    deviceValue_ = std::move(value);
    return *this;
  }
  CharacteristicSpec& format(NDString format) {
    format_ = std::move(format);
    return *this;
  }
  CharacteristicSpec& units(NDString units) {
    units_ = std::move(units);
    return *this;
  }
  /// Any limit may be null.
  CharacteristicSpec& limits(NDValueRef minimum, NDValueRef maximum, NDValueRef step = nullptr) {
    minimum_ = std::move(minimum);
    maximum_ = std::move(maximum);
    step_ = std::move(step);
    return *this;
  }
  CharacteristicSpec& limits(int minimum, int maximum, int step) {
    return limits(NDValue::integer(minimum), NDValue::integer(maximum), NDValue::integer(step));
  }
  CharacteristicSpec& limits(float minimum, float maximum, float step) {
    return limits(NDValue::floating(minimum), NDValue::floating(maximum), NDValue::floating(step));
  }
  CharacteristicSpec& withoutMetadata() {
    hasMetadata_ = false;
    return *this;
  }
  CharacteristicSpec& properties(std::vector<NDString> properties) {
    properties_ = std::move(properties);
    return *this;
  }
  CharacteristicSpec& readOnly() { return properties({"readable"}); }
  /// Otherwise the characteristics of an accessory are numbered from 1.
  CharacteristicSpec& instanceID(std::int64_t instanceID) {
    instanceID_ = instanceID;
    return *this;
  }

 private:
  friend class TestCharacteristic;
  NDString type_;
  NDValueRef value_;
  NDValueRef deviceValue_;
  NDString format_;
  NDString units_;
  NDValueRef minimum_;
  NDValueRef maximum_;
  NDValueRef step_;
  bool hasMetadata_ = true;
  std::vector<NDString> properties_ = {"readable", "writable"};
  std::int64_t instanceID_ = 0;
};

/// The characteristics that most tests use.
[[nodiscard]] CharacteristicSpec power(bool value);
[[nodiscard]] CharacteristicSpec brightness(int value);
[[nodiscard]] CharacteristicSpec currentTemperature(float value);
[[nodiscard]] CharacteristicSpec targetTemperature(float value);
[[nodiscard]] CharacteristicSpec identify();
/// A characteristic that the assistant has no name for.
[[nodiscard]] CharacteristicSpec unmapped();

}  // namespace nidus
