#pragma once

#include <cstddef>
#include <string>

namespace nidus {

/// What the calling process takes up.
struct ProcessFigures {
  std::size_t residentKiB = 0;   ///< Memory that is there.
  std::size_t allocatedKiB = 0;  ///< Of it, what has been allocated and not been freed.
  std::size_t threads = 0;
  std::size_t descriptors = 0;

  /// Measures, after free memory was given back to the system.
  [[nodiscard]] static ProcessFigures now();
  /// The figures on one line, for people.
  [[nodiscard]] std::string text() const;
};

}  // namespace nidus
