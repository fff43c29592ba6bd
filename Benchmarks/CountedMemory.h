#pragma once

#include <cstddef>

namespace nidus {

/// Counts the memory that this thread takes from the heap between its making and its end; there is
/// one at a time. The program's own operators of allocation report to it.
///
///     const CountedMemory counted;
///     perform();
///     report(counted.peak(), counted.held());
class CountedMemory {
 public:
  CountedMemory();
  ~CountedMemory();
  CountedMemory(const CountedMemory&) = delete;
  CountedMemory& operator=(const CountedMemory&) = delete;

  /// The most bytes that were held at a time, beyond those held at the beginning.
  [[nodiscard]] static std::ptrdiff_t peak();
  /// The bytes held now beyond those held at the beginning.
  [[nodiscard]] static std::ptrdiff_t held();
};

}  // namespace nidus
