#pragma once

#include <atomic>
#include <cstddef>
#include <functional>
#include <initializer_list>
#include <memory>
#include <string>
#include <string_view>
#include <utility>

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
  // NOLINTNEXTLINE(google-explicit-constructor): a literal is a text
  NDString(const char* text) : text_(text ? makeText(text) : nullptr) {}
  /// Copies `text`, which may be empty, but never gives null.
  // NOLINTNEXTLINE(google-explicit-constructor): as above
  NDString(std::string_view text) : text_(makeText(text)) {}
  // NOLINTNEXTLINE(google-explicit-constructor): as above
  NDString(const std::string& text) : text_(makeText(text)) {}

  /// Makes the text of all `parts`, one after the other.
  [[nodiscard]] static NDString joined(std::initializer_list<std::string_view> parts);

  NDString(const NDString& other) noexcept : text_(other.text_) { retain(); }
  NDString(NDString&& other) noexcept : text_(std::exchange(other.text_, nullptr)) {}
  NDString& operator=(const NDString& other) noexcept {
    NDString copy(other);
    std::swap(text_, copy.text_);
    return *this;
  }
  NDString& operator=(NDString&& other) noexcept {
    NDString taken(std::move(other));
    std::swap(text_, taken.text_);
    return *this;
  }
  ~NDString() { release(); }

  /// Says whether there is a text, be it empty.
  explicit operator bool() const noexcept { return text_ != nullptr; }

  /// Gives the characters; empty for null. Valid as long as any copy of this text lives.
  [[nodiscard]] std::string_view view() const noexcept {
    if (!text_) return {};
    return {charactersOf(text_), text_->length};
  }

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
  /// The head of the block that copies share; the characters follow it.
  struct Text {
    explicit Text(std::size_t textLength) noexcept : length(textLength) {}
    std::atomic<std::size_t> references{1};
    const std::size_t length;
  };

  static Text* makeText(std::size_t length);  ///< The characters are still to be written.
  static Text* makeText(std::string_view text);
  static void destroy(Text* text) noexcept;
  static char* charactersOf(Text* text) noexcept { return reinterpret_cast<char*>(text + 1); }

  void retain() const noexcept {
    if (text_) text_->references.fetch_add(1, std::memory_order_relaxed);
  }
  void release() const noexcept {
    if (!text_) return;
    // Whoever releases last must see all that the other owners did with the characters. An owner
    // that is the only one stays so, and need not count.
    if (text_->references.load(std::memory_order_acquire) == 1 ||
        text_->references.fetch_sub(1, std::memory_order_acq_rel) == 1) {
      destroy(text_);
    }
  }

  Text* text_ = nullptr;
};

}  // namespace nidus

template <>
struct std::hash<nidus::NDString> {
  std::size_t operator()(const nidus::NDString& text) const noexcept {
    return std::hash<std::string_view>{}(text.view());
  }
};
