#include "PlatformModel/System/NDUUID.h"

#include <pthread.h>
#include <sys/random.h>

#include <algorithm>
#include <atomic>
#include <bit>
#include <cerrno>
#include <cstring>
#include <system_error>

#include "PlatformModel/System/NDRunOnce.h"

namespace nidus {
namespace {

/// The two hexadecimal digits of each byte.
constexpr auto kDigitPairs = [] {
  constexpr std::string_view kDigits = "0123456789ABCDEF";
  std::array<std::array<char, 2>, 256> pairs{};
  for (std::size_t byte = 0; byte < pairs.size(); ++byte) {
    pairs[byte] = {kDigits[byte >> 4], kDigits[byte & 0x0F]};
  }
  return pairs;
}();

// Counts the forks of this process: bytes drawn before a fork belong to the parent, or parent and
// child would make the same UUIDs.
constinit std::atomic<unsigned> forkCount{0};
constinit NDRunOnce forkCounting;

void countForks() {
  forkCounting.run([] { pthread_atfork(nullptr, nullptr, [] { ++forkCount; }); });
}

/// Random bytes of one thread. The system call costs more than the bytes, so one call draws for
/// several UUIDs; that many bytes are always delivered whole.
struct RandomBytes {
  std::array<std::uint8_t, 256> bytes;
  std::size_t left;
  unsigned forkCountWhenDrawn;

  std::array<std::uint8_t, 16> take() {
    std::array<std::uint8_t, 16> taken{};
    if (left < taken.size() || forkCountWhenDrawn != forkCount) draw();
    left -= taken.size();
    std::copy_n(bytes.data() + left, taken.size(), taken.begin());
    return taken;
  }

 private:
  void draw() {
    countForks();
    forkCountWhenDrawn = forkCount;
    while (getrandom(bytes.data(), bytes.size(), 0) != static_cast<ssize_t>(bytes.size())) {
      if (errno != EINTR) throw std::system_error(errno, std::generic_category(), "getrandom");
    }
    left = bytes.size();
  }
};

constinit thread_local RandomBytes randomBytes{};

/// A bijection that makes each bit of the result depend on each bit of `value`.
constexpr std::uint64_t mixed(std::uint64_t value) noexcept {
  value = (value ^ value >> 33) * 0xFF51AFD7ED558CCD;
  value = (value ^ value >> 33) * 0xC4CEB9FE1A85EC53;
  return value ^ value >> 33;
}

/// Where the digits of each byte stand in the text, and where the dashes do.
constexpr std::array<std::size_t, 16> kDigitPlaces = {0,  2,  4,  6,  9,  11, 14, 16,
                                                      19, 21, 24, 26, 28, 30, 32, 34};
constexpr std::array<std::size_t, 4> kDashPlaces = {8, 13, 18, 23};

/// The value of each hexadecimal digit, -1 for any other character.
constexpr auto kDigitValues = [] {
  std::array<std::int8_t, 256> values{};
  values.fill(-1);
  for (const std::string_view digits : {"0123456789ABCDEF", "0123456789abcdef"}) {
    for (std::size_t value = 0; value < digits.size(); ++value) {
      values[static_cast<unsigned char>(digits[value])] = static_cast<std::int8_t>(value);
    }
  }
  return values;
}();

constexpr int digitValue(char digit) noexcept {
  return kDigitValues[static_cast<unsigned char>(digit)];
}

}  // namespace

NDUUID NDUUID::random() {
  std::array<std::uint8_t, 16> bytes = randomBytes.take();
  bytes[6] = static_cast<std::uint8_t>((bytes[6] & 0x0F) | 0x40);  // version 4
  bytes[8] = static_cast<std::uint8_t>((bytes[8] & 0x3F) | 0x80);  // the usual variant
  return NDUUID(bytes);
}

std::optional<NDUUID> NDUUID::fromText(std::string_view text) noexcept {
  if (text.size() != kTextLength) return std::nullopt;
  for (const std::size_t place : kDashPlaces) {
    if (text[place] != '-') return std::nullopt;
  }
  std::array<std::uint8_t, 16> bytes{};
  int allValues = 0;  // negative as soon as one of them is
  for (std::size_t index = 0; index < bytes.size(); ++index) {
    const char* const digits = &text[kDigitPlaces[index]];
    const int value = digitValue(digits[0]) << 4 | digitValue(digits[1]);
    allValues |= value;
    bytes[index] = static_cast<std::uint8_t>(value);
  }
  if (allValues < 0) return std::nullopt;
  return NDUUID(bytes);
}

NDString NDUUID::UUIDString() const {
  std::array<char, kTextLength> text{};
  writeText(text.data());
  return {std::string_view(text.data(), text.size())};
}

std::size_t NDUUID::hash() const noexcept {
  static const auto seed = std::bit_cast<std::array<std::uint64_t, 2>>(random().bytes());
  const auto halves = std::bit_cast<std::array<std::uint64_t, 2>>(bytes_);
  return mixed(mixed(halves[0] ^ seed[0]) ^ halves[1] ^ seed[1]);
}

void NDUUID::writeText(char* out) const noexcept {
  for (const std::size_t place : kDashPlaces) out[place] = '-';
  const std::array<std::uint8_t, 16> bytes = bytes_;  // which `out` cannot overlap
  for (std::size_t index = 0; index < bytes.size(); ++index) {
    const std::array<char, 2>& digits = kDigitPairs[bytes[index]];
    std::memcpy(out + kDigitPlaces[index], digits.data(), digits.size());
  }
}

}  // namespace nidus
