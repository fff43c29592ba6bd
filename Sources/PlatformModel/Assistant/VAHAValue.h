#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <utility>

#include "PlatformModel/System/NDDictionary.h"
#include "PlatformModel/System/NDExport.h"
#include "PlatformModel/System/NDString.h"

namespace nidus {

/// A typed value of the assistant with optional units: the base of the four value classes.
/// Not synchronised; shared as a reference to an object that nobody changes any more.
class ND_EXPORT VAHAValue {
 public:
  virtual ~VAHAValue();

  /// The assistant's unit name; may be null.
  [[nodiscard]] const NDString& units() const noexcept { return units_; }
  void setUnits(NDString units) { units_ = std::move(units); }

  /// Says whether `other` (may be null) is of this object's class or of one derived from it.
  [[nodiscard]] virtual bool isClassOf(const VAHAValue* other) const = 0;
  /// The value as text, for log messages; "(null)" for a string value without a string.
  [[nodiscard]] virtual std::string description() const = 0;
  /// The plain form: `{"boolean": true}` with "units" beside it when there are units.
  [[nodiscard]] NDDictionary dictionary() const;

 protected:
  VAHAValue() = default;
  VAHAValue(const VAHAValue&) = default;
  VAHAValue& operator=(const VAHAValue&) = default;
  virtual void addValue(NDDictionary& dictionary) const = 0;

 private:
  NDString units_;
};

/// A value or null.
using VAHAValueRef = std::shared_ptr<const VAHAValue>;

/// Gives the description of `value`, "(null)" for null.
[[nodiscard]] inline std::string description(const VAHAValueRef& value) {
  return value ? value->description() : "(null)";
}

/// A boolean.
class ND_EXPORT VAHABooleanValue : public VAHAValue {
 public:
  [[nodiscard]] static std::shared_ptr<VAHABooleanValue> booleanValue();
  [[nodiscard]] bool value() const noexcept { return value_; }
  void setValue(bool value) noexcept { value_ = value; }
  [[nodiscard]] bool isClassOf(const VAHAValue* other) const override;
  [[nodiscard]] std::string description() const override;

 protected:
  void addValue(NDDictionary& dictionary) const override;

 private:
  bool value_ = false;
};

/// A signed 64-bit integer.
class ND_EXPORT VAHAIntegerValue : public VAHAValue {
 public:
  [[nodiscard]] static std::shared_ptr<VAHAIntegerValue> integerValue();
  [[nodiscard]] std::int64_t value() const noexcept { return value_; }
  void setValue(std::int64_t value) noexcept { value_ = value; }
  [[nodiscard]] bool isClassOf(const VAHAValue* other) const override;
  [[nodiscard]] std::string description() const override;

 protected:
  void addValue(NDDictionary& dictionary) const override;

 private:
  std::int64_t value_ = 0;
};

/// A 32-bit float.
class ND_EXPORT VAHAFloatValue : public VAHAValue {
 public:
  [[nodiscard]] static std::shared_ptr<VAHAFloatValue> floatValue();
  [[nodiscard]] float value() const noexcept { return value_; }
  void setValue(float value) noexcept { value_ = value; }
  [[nodiscard]] bool isClassOf(const VAHAValue* other) const override;
  [[nodiscard]] std::string description() const override;

 protected:
  void addValue(NDDictionary& dictionary) const override;

 private:
  float value_ = 0;
};

/// A text, which may be null.
class ND_EXPORT VAHAStringValue : public VAHAValue {
 public:
  [[nodiscard]] static std::shared_ptr<VAHAStringValue> stringValue();
  [[nodiscard]] const NDString& value() const noexcept { return value_; }
  void setValue(NDString value) { value_ = std::move(value); }
  [[nodiscard]] bool isClassOf(const VAHAValue* other) const override;
  [[nodiscard]] std::string description() const override;

 protected:
  void addValue(NDDictionary& dictionary) const override;

 private:
  NDString value_;
};

}  // namespace nidus
