#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "HomePlatform/Json/JsonValue.h"
#include "PlatformModel/System/NDString.h"
#include "PlatformModel/System/NDUUID.h"
#include "PlatformModel/System/NDValue.h"

namespace nidus {

/// A value together with its place, read with checks. Every reader throws `JsonError` when the
/// value is not what is asked for. The document must outlive it.
///
///     JsonObject home(JsonPlaced(document, ""));
///     NDUUID uuid = home.required("uuid").uuid();
///     auto primary = home.optional("primary");  // none when absent or null
///     home.refuseUnknownKeys();
class JsonPlaced {
 public:
  JsonPlaced(const JsonValue& value, std::string place)
      : value_(&value), place_(std::move(place)) {}

  [[nodiscard]] const JsonValue& value() const { return *value_; }
  [[nodiscard]] const std::string& place() const { return place_; }
  [[nodiscard]] bool isNull() const;
  [[nodiscard]] bool boolean() const;
  /// A number without fraction and exponent from `least` to `greatest`.
  [[nodiscard]] std::int64_t integer(std::int64_t least, std::int64_t greatest) const;
  /// A text, which may be empty. Valid as long as the document.
  [[nodiscard]] const std::string& text() const;
  [[nodiscard]] NDUUID uuid() const;
  /// A boolean, number or text as a boxed value; never null.
  [[nodiscard]] NDValueRef boxed() const;
  /// The elements of an array with their places.
  [[nodiscard]] std::vector<JsonPlaced> array() const;
  /// Throws a `JsonError` with this place.
  [[noreturn]] void fail(const std::string& message) const;

 private:
  const JsonValue* value_;
  std::string place_;
};

/// An object whose keys are taken one by one, so that what is left over can be refused.
class JsonObject {
 public:
  /// Throws when `object` is none.
  explicit JsonObject(JsonPlaced object);

  /// The value of a key that must be there. `key` is a literal, here and below.
  [[nodiscard]] JsonPlaced required(std::string_view key);
  /// The value of a key; none when it is absent or null.
  [[nodiscard]] std::optional<JsonPlaced> optional(std::string_view key);
  /// Says that `key` may be there, without reading it.
  void allow(std::string_view key);
  /// Throws for the first key that was never asked for; the message lists those that were.
  void refuseUnknownKeys() const;
  [[nodiscard]] const JsonPlaced& placed() const { return object_; }

 private:
  [[nodiscard]] const JsonValue* find(std::string_view key) const;
  [[nodiscard]] JsonPlaced placedAt(std::string_view key, const JsonValue& value) const;

  JsonPlaced object_;
  const JsonValue::Object* members_;
  std::vector<std::string_view> known_;
};

}  // namespace nidus
