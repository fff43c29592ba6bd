#include "PlatformModel/System/NDUUID.h"

#include <pthread.h>
#include <sys/random.h>

#include <algorithm>
#include <atomic>
#include <bit>
#include <cerrno>
#include <system_error>

#include "PlatformModel/System/NDRunOnce.h"

namespace nidus {
namespace {

constexpr std::string_view kDigits = "0123456789ABCDEF";

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

constexpr bool isDashPosition(std::size_t position) {
  return position == 8 || position == 13 || position == 18 || position == 23;
}

/// A bijection that makes each bit of the result depend on each bit of `value`.
constexpr std::uint64_t mixed(std::uint64_t value) noexcept {
  value = (value ^ value >> 33) * 0xFF51AFD7ED558CCD;
  value = (value ^ value >> 33) * 0xC4CEB9FE1A85EC53;
  return value ^ value >> 33;
}

/// The value of a hexadecimal digit, -1 for any other character.
constexpr int digitValue(char digit) noexcept {
  if (digit >= '0' && digit <= '9') return digit - '0';
  if (digit >= 'A' && digit <= 'F') return digit - 'A' + 10;
  if (digit >= 'a' && digit <= 'f') return digit - 'a' + 10;
  return -1;
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
  std::array<std::uint8_t, 16> bytes{};
  std::size_t digits = 0;
  for (std::size_t position = 0; position < kTextLength; ++position) {
    if (isDashPosition(position)) {
      if (text[position] != '-') return std::nullopt;
      continue;
    }
    const int value = digitValue(text[position]);
    if (value < 0) return std::nullopt;
    std::uint8_t& byte = bytes[digits++ / 2];
    byte = static_cast<std::uint8_t>(byte << 4 | value);
  }
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
  std::size_t position = 0;
  for (const std::uint8_t byte : bytes_) {
    if (isDashPosition(position)) out[position++] = '-';
    out[position++] = kDigits[byte >> 4];
    out[position++] = kDigits[byte & 0x0F];
  }
}

}  // namespace nidus
