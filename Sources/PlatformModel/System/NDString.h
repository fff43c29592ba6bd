#pragma once

#include <cstddef>
#include <functional>
#include <memory>
#include <string>
#include <string_view>

#include "PlatformModel/System/NDExport.h"

namespace nidus {

/// An immutable UTF-8 text that is shared by reference and may be null.
///
/// Null is "there is none" and differs from the empty text. Copies share the characters, so that
/// records, entities and results can carry the names of a home without copying them.
/// May be used from any thread; a single object must not be assigned to while another thread
/// reads that same object.
///
///     NDString name = "Kitchen";
///     if (name) log(name.view());
///     NDString none;               // null; none.view() is empty
class ND_EXPORT NDString {
 public:
  /// Makes the null text.
  NDString() noexcept = default;
  NDString(std::nullptr_t) noexcept {}  // NOLINT(google-explicit-constructor): null is a text
  /// Copies `text`; a null pointer gives the null text.
  NDString(const char* text);  // NOLINT(google-explicit-constructor): a literal is a text
  /// Copies `text`, which may be empty, but never gives null.
  NDString(std::string_view text);    // NOLINT(google-explicit-constructor): as above
  NDString(const std::string& text);  // NOLINT(google-explicit-constructor): as above

  NDString(const NDString& other) noexcept;
  NDString(NDString&& other) noexcept;
  NDString& operator=(const NDString& other) noexcept;
  NDString& operator=(NDString&& other) noexcept;
  ~NDString();

  /// Says whether there is a text, be it empty.
  explicit operator bool() const noexcept { return text_ != nullptr; }

  /// Gives the characters; empty for null. Valid as long as any copy of this text lives.
  [[nodiscard]] std::string_view view() const noexcept;

  /// Copies the characters; empty for null.
  [[nodiscard]] std::string str() const { return std::string(view()); }

  /// Compares code point by code point; null equals null alone.
  friend bool operator==(const NDString& a, const NDString& b) noexcept {
    return a.text_ == b.text_ || (a.text_ && b.text_ && a.view() == b.view());
  }
  /// Compares with characters; null equals none, the empty ones included.
  friend bool operator==(const NDString& a, std::string_view b) noexcept {
    return a.text_ && a.view() == b;
  }
  /// The same; a null pointer equals null.
  friend bool operator==(const NDString& a, const char* b) noexcept {
    return b ? a == std::string_view(b) : !a.text_;
  }

 private:
  struct Text;  // reference count, length and characters in one block
  Text* text_ = nullptr;
};

}  // namespace nidus

template <>
struct std::hash<nidus::NDString> {
  std::size_t operator()(const nidus::NDString& text) const noexcept {
    return std::hash<std::string_view>{}(text.view());
  }
};
