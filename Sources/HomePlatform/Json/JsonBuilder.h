#pragma once

#include <cstddef>
#include <limits>
#include <string>
#include <string_view>
#include <vector>

#include "HomePlatform/Json/JsonReader.h"
#include "HomePlatform/Json/JsonValue.h"

namespace nidus {

/// Puts events together again to one value.
///
///     JsonBuilder builder;
///     readJson(text, builder);
///     JsonValue value = builder.take();
class JsonBuilder final : public JsonEvents {
 public:
  /// Values beyond `maximumValues`, counting objects and arrays too, are refused with an error, so
  /// that a reader who expects something small needs no more memory than that.
  explicit JsonBuilder(std::size_t maximumValues = std::numeric_limits<std::size_t>::max())
      : maximumValues_(maximumValues) {}

  void scalar(JsonValue value, const JsonPath& path) override;
  void beginObject(const JsonPath& path) override;
  void key(std::string_view key, const JsonPath& path) override;
  void endObject(const JsonPath& path) override;
  void beginArray(const JsonPath& path) override;
  void endArray(const JsonPath& path) override;

  /// Whether one whole value has been put together.
  [[nodiscard]] bool isComplete() const noexcept { return isComplete_; }
  /// Gives the value away and starts anew; what was given away still counts.
  [[nodiscard]] JsonValue take();

 private:
  void countValue(const JsonPath& path);
  void place(JsonValue value);
  void close();

  std::size_t maximumValues_;
  std::size_t count_ = 0;
  bool isComplete_ = false;
  JsonValue root_;
  std::vector<JsonValue> open_;    ///< The objects and arrays that have not ended.
  std::vector<std::string> keys_;  ///< The key under which each of `open_` takes its next value.
};

}  // namespace nidus
