#include "HomePlatform/Store/ValueConversion.h"

#include <array>
#include <bit>
#include <cmath>
#include <cstdint>
#include <limits>
#include <optional>
#include <string_view>

#include "PlatformModel/System/NDTextMatching.h"

namespace nidus {
namespace {

struct IntegerFormat {
  std::string_view name;
  std::int64_t least;
  std::int64_t greatest;
};

template <class Integer>
constexpr IntegerFormat rangeOf(std::string_view name) {
  return {name, std::numeric_limits<Integer>::min(), std::numeric_limits<Integer>::max()};
}

constexpr std::array kIntegerFormats = {
    rangeOf<std::int32_t>("int"),
    rangeOf<std::uint8_t>("uint8"),
    rangeOf<std::uint16_t>("uint16"),
    rangeOf<std::uint32_t>("uint32"),
    IntegerFormat{"uint64", 0, std::numeric_limits<std::int64_t>::max()},
};

const IntegerFormat* integerFormat(const NDString& name) {
  for (const IntegerFormat& format : kIntegerFormats) {
    if (name == format.name) return &format;
  }
  return nullptr;
}

/// What no document could hold: JSON has neither infinities nor not-a-number, and texts in UTF-8.
bool isUnwritable(const NDValue& value) {
  if (value.isText()) return !isUTF8(value.stringValue().view());
  return value.isFloating() && !std::isfinite(value.floatValue());
}

/// The integer nearest to a finite number, halves away from zero; none beyond 64 bits.
std::optional<std::int64_t> rounded(const NDValue& number) {
  if (!number.isFloating()) return number.integerValue();
  constexpr float kBeyond = 9223372036854775808.0F;  // 2^63, which no 64-bit integer reaches
  const float nearest = std::round(number.floatValue());
  if (nearest < -kBeyond || nearest >= kBeyond) return std::nullopt;
  return static_cast<std::int64_t>(nearest);
}

NDValueRef toInteger(const NDValueRef& value, const IntegerFormat& format) {
  const std::optional<std::int64_t> number = rounded(*value);
  if (!number || *number < format.least || *number > format.greatest) return nullptr;
  return value->isInteger() ? value : NDValue::integer(*number);
}

}  // namespace

NDValueRef convertToFormat(const NDValueRef& value, const NDString& format) {
  if (!value) return nullptr;
  const bool isNumber = value->isNumber();
  if (format == "bool") {
    if (!isNumber) return nullptr;
    return value->isBoolean() ? value : NDValue::boolean(value->boolValue());
  }
  if (isUnwritable(*value)) return nullptr;
  if (format == "string") return isNumber ? nullptr : value;
  if (format == "float") {
    if (!isNumber) return nullptr;
    return value->isFloating() ? value : NDValue::floating(value->floatValue());
  }
  const IntegerFormat* integers = integerFormat(format);
  if (!integers) return value;
  return isNumber ? toInteger(value, *integers) : nullptr;
}

bool isSameValue(const NDValueRef& a, const NDValueRef& b) {
  if (a == b) return true;
  if (!a || !b || a->isBoolean() != b->isBoolean() || a->isFloating() != b->isFloating()) {
    return false;
  }
  if (!a->isFloating()) return a->isEqual(*b);
  return std::bit_cast<std::uint32_t>(a->floatValue()) ==
         std::bit_cast<std::uint32_t>(b->floatValue());
}

}  // namespace nidus
