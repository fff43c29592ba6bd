#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <utility>
#include <variant>
#include <vector>

#include "PlatformModel/System/NDExport.h"
#include "PlatformModel/System/NDString.h"

namespace nidus {

class NDDictionaryValue;

/// A list of values in dictionary form.
using NDDictionaryList = std::vector<NDDictionaryValue>;

/// The plain form of an object: a map from text keys to plain values that keeps the order in which
/// the keys were set. A plain value type; not synchronised.
class ND_EXPORT NDDictionary {
 public:
  using Entry = std::pair<std::string, NDDictionaryValue>;

  /// Makes room for `count` keys.
  void reserve(std::size_t count);
  /// Sets `key`, replacing an earlier value.
  void set(std::string_view key, NDDictionaryValue value);
  /// Sets `key` to `text` unless `text` is null.
  void setIfPresent(std::string_view key, const NDString& text);
  /// The value of `key`; null when the key is absent. Valid until the dictionary changes.
  [[nodiscard]] const NDDictionaryValue* find(std::string_view key) const noexcept;
  [[nodiscard]] bool empty() const noexcept;
  [[nodiscard]] std::size_t size() const noexcept;
  [[nodiscard]] std::vector<Entry>::const_iterator begin() const noexcept;
  [[nodiscard]] std::vector<Entry>::const_iterator end() const noexcept;
  friend ND_EXPORT bool operator==(const NDDictionary& a, const NDDictionary& b);

 private:
  std::vector<Entry> entries_;
};

/// A plain value: null, boolean, integer, float, text, list or dictionary. A text is never null;
/// an `NDString` that is null makes the null value.
class ND_EXPORT NDDictionaryValue {
 public:
  using Content = std::variant<std::nullptr_t, bool, std::int64_t, float, NDString,
                               NDDictionaryList, NDDictionary>;

  NDDictionaryValue() noexcept : content_(nullptr) {}
  explicit NDDictionaryValue(bool value) : content_(value) {}
  explicit NDDictionaryValue(std::int64_t value) : content_(value) {}
  explicit NDDictionaryValue(float value) : content_(value) {}
  explicit NDDictionaryValue(NDString value);
  explicit NDDictionaryValue(NDDictionaryList value) : content_(std::move(value)) {}
  explicit NDDictionaryValue(NDDictionary value) : content_(std::move(value)) {}

  [[nodiscard]] const Content& content() const noexcept { return content_; }
  friend ND_EXPORT bool operator==(const NDDictionaryValue& a, const NDDictionaryValue& b);

 private:
  Content content_;
};

}  // namespace nidus
