#pragma once

#include <array>
#include <bit>
#include <compare>
#include <cstddef>
#include <cstdint>
#include <functional>
#include <optional>
#include <string_view>

#include "PlatformModel/System/NDExport.h"
#include "PlatformModel/System/NDString.h"

namespace nidus {

/// A 128-bit universally unique identifier. A plain value; may be used from any thread.
class ND_EXPORT NDUUID {
 public:
  /// The number of characters of the canonical text.
  static constexpr std::size_t kTextLength = 36;

  /// Makes the UUID whose bits are all zero.
  constexpr NDUUID() noexcept = default;
  explicit constexpr NDUUID(const std::array<std::uint8_t, 16>& bytes) noexcept : bytes_(bytes) {}

  /// Makes a random UUID (version 4) from the system's random source.
  [[nodiscard]] static NDUUID random();

  /// Reads the 8-4-4-4-12 form in either letter case; none for anything else.
  [[nodiscard]] static std::optional<NDUUID> fromText(std::string_view text) noexcept;

  /// Gives the canonical text: upper case, 8-4-4-4-12.
  [[nodiscard]] NDString UUIDString() const;

  /// Writes the canonical text, `kTextLength` characters without a terminator, to `out`.
  void writeText(char* out) const noexcept;

  [[nodiscard]] constexpr const std::array<std::uint8_t, 16>& bytes() const noexcept {
    return bytes_;
  }
  /// A number for look-ups, the same as long as the process lives. It differs from process to
  /// process, so that nobody can think of UUIDs that make look-ups slow.
  [[nodiscard]] std::size_t hash() const noexcept;

  friend constexpr bool operator==(const NDUUID& a, const NDUUID& b) noexcept {
    // As two numbers: batches find their accessories by comparing.
    using Halves = std::array<std::uint64_t, 2>;
    return std::bit_cast<Halves>(a.bytes_) == std::bit_cast<Halves>(b.bytes_);
  }
  // NOLINTNEXTLINE(modernize-use-nullptr): the check takes the default for a null pointer
  friend constexpr auto operator<=>(const NDUUID&, const NDUUID&) noexcept = default;

 private:
  std::array<std::uint8_t, 16> bytes_{};
};

}  // namespace nidus

template <>
struct std::hash<nidus::NDUUID> {
  std::size_t operator()(const nidus::NDUUID& uuid) const noexcept { return uuid.hash(); }
};
