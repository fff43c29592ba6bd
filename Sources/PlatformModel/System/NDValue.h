#pragma once

#include <compare>
#include <cstdint>
#include <memory>
#include <string>
#include <variant>

#include "PlatformModel/System/NDExport.h"
#include "PlatformModel/System/NDString.h"

namespace nidus {

class NDValue;
/// A platform value or null. Identity matters: a conversion that gives back "the same object"
/// gives back the same pointer.
using NDValueRef = std::shared_ptr<const NDValue>;

/// A boxed platform value: a boolean, a signed 64-bit integer, a 32-bit float or a text.
///
/// Immutable and shared by reference; may be used from any thread.
///
///     NDValueRef level = NDValue::integer(40);
///     float asFloat = level->floatValue();  // 40.0F
class ND_EXPORT NDValue {
 public:
  /// Each gives a new object, never null.
  [[nodiscard]] static NDValueRef boolean(bool value);
  [[nodiscard]] static NDValueRef integer(std::int64_t value);
  [[nodiscard]] static NDValueRef floating(float value);
  /// `text` must not be null.
  [[nodiscard]] static NDValueRef text(NDString text);

  [[nodiscard]] bool isBoolean() const noexcept;
  [[nodiscard]] bool isInteger() const noexcept;
  [[nodiscard]] bool isFloating() const noexcept;
  [[nodiscard]] bool isText() const noexcept;
  /// True for booleans, integers and floats; text is never a number.
  [[nodiscard]] bool isNumber() const noexcept { return !isText(); }

  /// True for any non-zero number, not-a-number included; false for text.
  [[nodiscard]] bool boolValue() const noexcept;
  /// A float is cut toward zero and kept within 64 bits, not-a-number gives 0; text gives 0.
  [[nodiscard]] std::int64_t integerValue() const noexcept;
  /// The nearest 32-bit float; text gives 0.
  [[nodiscard]] float floatValue() const noexcept;
  /// The text; null for a number.
  [[nodiscard]] NDString stringValue() const noexcept;

  /// Orders two numbers exactly, whatever their kinds (true is 1, false is 0).
  /// Null, text and not-a-number are unordered: neither below nor above anything.
  [[nodiscard]] std::partial_ordering compare(const NDValueRef& other) const noexcept;

  /// Numbers are equal by number, texts by text; a number never equals a text.
  [[nodiscard]] bool isEqual(const NDValue& other) const noexcept;

  /// `0` or `1`, an integer's decimal text, the shortest text that reads back as the same 32-bit
  /// float, or the text itself.
  [[nodiscard]] std::string description() const;

  /// For the four factories alone.
  using Content = std::variant<bool, std::int64_t, float, NDString>;
  explicit NDValue(Content content) : content_(std::move(content)) {}

 private:
  [[nodiscard]] std::partial_ordering compareWith(const NDValue& other) const noexcept;

  Content content_;
};

/// Gives the description of `value`, "(null)" for null.
[[nodiscard]] ND_EXPORT std::string description(const NDValueRef& value);

}  // namespace nidus
