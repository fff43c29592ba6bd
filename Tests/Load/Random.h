#pragma once

#include <cstddef>
#include <cstdint>
#include <random>

namespace nidus {

/// Draws numbers; the same seed draws the same ones. Used by one thread.
class Random {
 public:
  explicit Random(std::uint64_t seed) : engine_(seed) {}

  /// A number less than `count`, which is at least 1.
  [[nodiscard]] std::size_t below(std::size_t count) { return engine_() % count; }
  /// True once in `count` times.
  [[nodiscard]] bool oneIn(std::size_t count) { return below(count) == 0; }
  /// A seed for another one.
  [[nodiscard]] std::uint64_t seed() { return engine_(); }

 private:
  std::mt19937_64 engine_;
};

}  // namespace nidus
