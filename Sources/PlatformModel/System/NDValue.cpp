#include "PlatformModel/System/NDValue.h"

#include <cmath>
#include <limits>

#include "PlatformModel/System/NDNumberText.h"

namespace nidus {
namespace {

// 2^63, the first float above all 64-bit integers; its negative is the least of them.
constexpr float kIntegerEnd = 9223372036854775808.0F;

std::int64_t integerOfFloat(float value) noexcept {
  if (std::isnan(value)) return 0;
  if (value >= kIntegerEnd) return std::numeric_limits<std::int64_t>::max();
  if (value < -kIntegerEnd) return std::numeric_limits<std::int64_t>::min();
  return static_cast<std::int64_t>(value);
}

// Widening the integer would round it, so the whole parts are compared as integers.
std::partial_ordering compareNumbers(std::int64_t a, float b) noexcept {
  if (std::isnan(b)) return std::partial_ordering::unordered;
  if (b >= kIntegerEnd) return std::partial_ordering::less;
  if (b < -kIntegerEnd) return std::partial_ordering::greater;
  const float whole = std::trunc(b);
  const std::partial_ordering byWhole = a <=> static_cast<std::int64_t>(whole);
  return std::is_neq(byWhole) ? byWhole : 0.0F <=> b - whole;
}

std::partial_ordering reversed(std::partial_ordering order) noexcept {
  if (std::is_lt(order)) return std::partial_ordering::greater;
  return std::is_gt(order) ? std::partial_ordering::less : order;
}

std::partial_ordering compareNumbers(std::int64_t a, std::int64_t b) noexcept { return a <=> b; }
std::partial_ordering compareNumbers(float a, float b) noexcept { return a <=> b; }
std::partial_ordering compareNumbers(float a, std::int64_t b) noexcept {
  return reversed(compareNumbers(b, a));
}

}  // namespace

NDValueRef NDValue::boolean(bool value) { return std::make_shared<NDValue>(Content(value)); }

NDValueRef NDValue::integer(std::int64_t value) {
  return std::make_shared<NDValue>(Content(value));
}

NDValueRef NDValue::floating(float value) { return std::make_shared<NDValue>(Content(value)); }

NDValueRef NDValue::text(NDString text) {
  return std::make_shared<NDValue>(Content(std::move(text)));
}

bool NDValue::isBoolean() const noexcept { return std::holds_alternative<bool>(content_); }

bool NDValue::isInteger() const noexcept { return std::holds_alternative<std::int64_t>(content_); }

bool NDValue::isFloating() const noexcept { return std::holds_alternative<float>(content_); }

bool NDValue::isText() const noexcept { return std::holds_alternative<NDString>(content_); }

bool NDValue::boolValue() const noexcept {
  if (const auto* number = std::get_if<float>(&content_)) return *number != 0.0F;
  return integerValue() != 0;
}

std::int64_t NDValue::integerValue() const noexcept {
  if (const auto* flag = std::get_if<bool>(&content_)) return *flag ? 1 : 0;
  if (const auto* number = std::get_if<std::int64_t>(&content_)) return *number;
  if (const auto* number = std::get_if<float>(&content_)) return integerOfFloat(*number);
  return 0;
}

float NDValue::floatValue() const noexcept {
  if (const auto* number = std::get_if<float>(&content_)) return *number;
  return static_cast<float>(integerValue());
}

NDString NDValue::stringValue() const noexcept {
  const auto* text = std::get_if<NDString>(&content_);
  return text ? *text : NDString();
}

std::partial_ordering NDValue::compare(const NDValueRef& other) const noexcept {
  return other ? compareWith(*other) : std::partial_ordering::unordered;
}

std::partial_ordering NDValue::compareWith(const NDValue& other) const noexcept {
  if (isText() || other.isText()) return std::partial_ordering::unordered;
  if (isFloating() && other.isFloating()) return compareNumbers(floatValue(), other.floatValue());
  if (isFloating()) return compareNumbers(floatValue(), other.integerValue());
  if (other.isFloating()) return compareNumbers(integerValue(), other.floatValue());
  return compareNumbers(integerValue(), other.integerValue());
}

bool NDValue::isEqual(const NDValue& other) const noexcept {
  if (isText() || other.isText()) {
    return isText() && other.isText() && stringValue() == other.stringValue();
  }
  return std::is_eq(compareWith(other));
}

std::string NDValue::description() const {
  if (const auto* number = std::get_if<float>(&content_)) return numberText(*number);
  if (const auto* text = std::get_if<NDString>(&content_)) return text->str();
  return numberText(integerValue());
}

std::string description(const NDValueRef& value) { return value ? value->description() : "(null)"; }

}  // namespace nidus
