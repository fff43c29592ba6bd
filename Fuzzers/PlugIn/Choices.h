#pragma once

#include <fuzzer/FuzzedDataProvider.h>

#include <cstddef>
#include <iterator>

namespace nidus {

/// An input as a row of choices; once it is used up, each choice is the first one.
class Choices {
 public:
  Choices(const std::uint8_t* data, std::size_t size) : input_(data, size) {}

  /// A number from 0 to `greatest`.
  [[nodiscard]] std::size_t upTo(std::size_t greatest) {
    return input_.ConsumeIntegralInRange<std::size_t>(0, greatest);
  }
  [[nodiscard]] bool chance(int percent) {
    return input_.ConsumeIntegralInRange(0, 99) >= 100 - percent;
  }
  /// An element of a list that is not empty.
  template <class List>
  [[nodiscard]] auto oneOf(const List& list) {
    return *(std::begin(list) + static_cast<std::ptrdiff_t>(upTo(std::size(list) - 1)));
  }
  template <class Number>
  [[nodiscard]] Number number() {
    return input_.ConsumeIntegral<Number>();
  }

 private:
  FuzzedDataProvider input_;
};

}  // namespace nidus
