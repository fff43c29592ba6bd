#pragma once

#include <cstddef>
#include <initializer_list>
#include <memory>
#include <utility>
#include <vector>

namespace nidus {

/// An immutable, ordered list of shared objects, itself shared by reference.
///
/// Elements are never null, may repeat, and stay alive as long as any copy of the list does.
/// Copying costs one reference count. May be read from any thread.
///
///     for (const auto& room : home.rooms()) visit(*room);
template <class T>
class NDArray {
 public:
  using Element = std::shared_ptr<T>;
  using const_iterator = const Element*;

  /// Makes the empty list.
  NDArray() noexcept = default;
  /// Takes over `elements`, none of which may be null.
  explicit NDArray(std::vector<Element> elements)
      : elements_(std::make_shared<const std::vector<Element>>(std::move(elements))) {}
  NDArray(std::initializer_list<Element> elements) : NDArray(std::vector<Element>(elements)) {}

  [[nodiscard]] std::size_t size() const noexcept { return elements_ ? elements_->size() : 0; }
  [[nodiscard]] bool empty() const noexcept { return size() == 0; }
  [[nodiscard]] const_iterator begin() const noexcept {
    return elements_ ? elements_->data() : nullptr;
  }
  [[nodiscard]] const_iterator end() const noexcept {
    return elements_ ? elements_->data() + elements_->size() : nullptr;
  }
  /// Gives the element at `index`, which must be less than `size()`.
  [[nodiscard]] const Element& operator[](std::size_t index) const { return (*elements_)[index]; }

 private:
  std::shared_ptr<const std::vector<Element>> elements_;
};

}  // namespace nidus
