#include "PlatformModel/System/NDString.h"

#include <atomic>
#include <new>
#include <utility>

namespace nidus {

struct NDString::Text {
  explicit Text(std::size_t textLength) noexcept : length(textLength) {}

  // The characters follow the block's head in the same allocation.
  [[nodiscard]] char* characters() noexcept { return reinterpret_cast<char*>(this + 1); }

  static Text* make(std::string_view text) {
    void* block = ::operator new(sizeof(Text) + text.size());
    auto* made = new (block) Text(text.size());
    text.copy(made->characters(), text.size());
    return made;
  }

  static Text* retain(Text* text) noexcept {
    if (text) text->references.fetch_add(1, std::memory_order_relaxed);
    return text;
  }

  static void release(Text* text) noexcept {
    if (!text) return;
    // Whoever releases last must see all that the other owners did with the characters.
    if (text->references.fetch_sub(1, std::memory_order_acq_rel) != 1) return;
    text->~Text();
    ::operator delete(text);
  }

  std::atomic<std::size_t> references{1};
  const std::size_t length;
};

NDString::NDString(const char* text) : text_(text ? Text::make(text) : nullptr) {}

NDString::NDString(std::string_view text) : text_(Text::make(text)) {}

NDString::NDString(const std::string& text) : text_(Text::make(text)) {}

NDString::NDString(const NDString& other) noexcept : text_(Text::retain(other.text_)) {}

NDString::NDString(NDString&& other) noexcept : text_(std::exchange(other.text_, nullptr)) {}

NDString& NDString::operator=(const NDString& other) noexcept {
  NDString copy(other);
  std::swap(text_, copy.text_);
  return *this;
}

NDString& NDString::operator=(NDString&& other) noexcept {
  if (this != &other) Text::release(std::exchange(text_, std::exchange(other.text_, nullptr)));
  return *this;
}

NDString::~NDString() { Text::release(text_); }

std::string_view NDString::view() const noexcept {
  return text_ ? std::string_view(text_->characters(), text_->length) : std::string_view();
}

}  // namespace nidus
