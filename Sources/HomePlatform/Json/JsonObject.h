#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "HomePlatform/Json/JsonValue.h"
#include "PlatformModel/System/NDString.h"
#include "PlatformModel/System/NDUUID.h"
#include "PlatformModel/System/NDValue.h"

namespace nidus {

/// A value together with its place, read with checks. Every reader throws `JsonError` when the
/// value is not what is asked for. Cheap to copy; the document must outlive it.
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
  [[nodiscard]] std::int64_t integer(std::int64_t least, std::int64_t greatest) const;
  [[nodiscard]] std::string text() const;
  [[nodiscard]] NDUUID uuid() const;
  /// A boolean, number or text as a boxed value; never null.
  [[nodiscard]] NDValueRef boxed() const;
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
  explicit JsonObject(JsonPlaced object);

  /// The value of a key that must be there.
  [[nodiscard]] JsonPlaced required(std::string_view key);
  /// The value of a key; none when it is absent or null.
  [[nodiscard]] std::optional<JsonPlaced> optional(std::string_view key);
  /// Throws for the first key that was never asked for.
  void refuseUnknownKeys() const;
  [[nodiscard]] const JsonPlaced& placed() const { return object_; }

 private:
  JsonPlaced object_;
  std::vector<bool> taken_;
};

}  // namespace nidus
