#include "PlatformModel/System/NDTextMatching.h"

#include <algorithm>
#include <array>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <span>

#include "PlatformModel/System/UnicodeTables.h"

namespace nidus {
namespace {

constexpr bool isASCII(char c) noexcept { return static_cast<unsigned char>(c) < 0x80; }

constexpr char lowerCase(char c) noexcept {
  return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c;
}

/// The length of the UTF-8 sequence that begins with `lead`; 0 when none does.
constexpr std::size_t sequenceLength(unsigned char lead) noexcept {
  if (lead < 0x80) return 1;
  if (lead >= 0xC2 && lead < 0xE0) return 2;
  if (lead >= 0xE0 && lead < 0xF0) return 3;
  return lead >= 0xF0 && lead < 0xF5 ? 4 : 0;
}

constexpr char32_t kBeyondUnicode = 0x110000;

constexpr bool isScalarOfLength(char32_t codePoint, std::size_t length) noexcept {
  constexpr char32_t kLeastOfLength[] = {0, 0, 0x80, 0x800, 0x10000};
  return codePoint >= kLeastOfLength[length] && codePoint < kBeyondUnicode &&
         (codePoint < 0xD800 || codePoint > 0xDFFF);
}

/// A byte that is not UTF-8 becomes a number beyond all code points, so it matches itself alone.
char32_t takeByte(std::string_view& text) noexcept {
  const auto byte = static_cast<unsigned char>(text.front());
  text.remove_prefix(1);
  return kBeyondUnicode + byte;
}

char32_t takeCodePoint(std::string_view& text) noexcept {
  const auto lead = static_cast<unsigned char>(text.front());
  const std::size_t length = sequenceLength(lead);
  if (length == 0 || length > text.size()) return takeByte(text);
  char32_t codePoint = length == 1 ? lead : lead & (0x7FU >> length);
  for (std::size_t i = 1; i < length; ++i) {
    const auto byte = static_cast<unsigned char>(text[i]);
    if ((byte & 0xC0) != 0x80) return takeByte(text);
    codePoint = codePoint << 6 | (byte & 0x3FU);
  }
  if (!isScalarOfLength(codePoint, length)) return takeByte(text);
  text.remove_prefix(length);
  return codePoint;
}

/// The parts of a Hangul syllable, which follow from a rule that is part of the Unicode standard;
/// none for other code points.
std::span<const char32_t> hangulParts(char32_t codePoint, std::array<char32_t, 3>& parts) {
  constexpr char32_t kFirstSyllable = 0xAC00;
  constexpr char32_t kLeadBase = 0x1100;
  constexpr char32_t kVowelBase = 0x1161;
  constexpr char32_t kTrailBase = 0x11A7;
  constexpr char32_t kVowels = 21;
  constexpr char32_t kTrails = 28;
  constexpr char32_t kSyllables = 19 * kVowels * kTrails;
  if (codePoint < kFirstSyllable || codePoint >= kFirstSyllable + kSyllables) return {};
  const char32_t index = codePoint - kFirstSyllable;
  parts = {kLeadBase + index / (kVowels * kTrails), kVowelBase + index / kTrails % kVowels,
           kTrailBase + index % kTrails};
  return {parts.data(), index % kTrails == 0 ? 2U : 3U};
}

/// The canonical decomposition of a code point; none for one that stays what it is.
std::span<const char32_t> decomposition(char32_t codePoint) noexcept {
  const auto entry = std::lower_bound(
      kDecompositions.begin(), kDecompositions.end(), codePoint,
      [](const Decomposition& candidate, char32_t wanted) { return candidate.codePoint < wanted; });
  if (entry == kDecompositions.end() || entry->codePoint != codePoint) return {};
  return kDecompositionPool.subspan(entry->offset, entry->length);
}

/// The range that holds `codePoint`; null for what has no combining class and is no mark.
const CombiningRange* combiningRange(char32_t codePoint) noexcept {
  const auto range = std::lower_bound(
      kCombiningRanges.begin(), kCombiningRanges.end(), codePoint,
      [](const CombiningRange& candidate, char32_t wanted) { return candidate.last < wanted; });
  return range != kCombiningRanges.end() && range->first <= codePoint ? &*range : nullptr;
}

std::uint8_t combiningClass(char32_t codePoint) noexcept {
  const CombiningRange* range = combiningRange(codePoint);
  return range ? range->combiningClass : 0;
}

/// Gives the code points of a text without its diacritics, one after the other. Few of them are
/// held at a time, so names are read without memory of their own.
class FoldedText {
 public:
  explicit FoldedText(std::string_view text) noexcept : rest_(text) {}

  /// The next code point; `kEnd` after the last one.
  char32_t next() {
    if (given_ == settled_) settleMore();
    return given_ < settled_ ? held_[given_++] : kEnd;
  }

  static constexpr char32_t kEnd = 0xFFFFFFFF;

 private:
  void settleMore() {
    held_.erase(0, given_);
    given_ = settled_ = 0;
    while (settled_ == 0 && !rest_.empty()) takeDecomposed(takeCodePoint(rest_));
    if (settled_ == 0) settleRun();
  }

  void takeDecomposed(char32_t codePoint) {
    if (codePoint < 0x80) return takeStarter(codePoint);
    std::array<char32_t, 3> syllable{};
    auto parts = hangulParts(codePoint, syllable);
    if (parts.empty()) parts = decomposition(codePoint);
    if (parts.empty()) parts = {&codePoint, 1};
    for (const char32_t part : parts) take(part);
  }

  void take(char32_t codePoint) {
    const CombiningRange* range = combiningRange(codePoint);
    if (!range) return takeStarter(codePoint);
    // A mark without a class goes too, but keeps what is before it from moving past it.
    if (range->combiningClass == 0) settleRun();
    if (!range->isNonspacingMark) held_.push_back(codePoint);
  }

  void takeStarter(char32_t codePoint) {
    settleRun();
    held_.push_back(codePoint);
    settled_ = held_.size();
  }

  /// Puts the combining characters that have come since the last starter into the order of their
  /// classes. They move no more.
  void settleRun() {
    if (held_.size() - settled_ > 1) {
      std::stable_sort(
          held_.begin() + static_cast<std::ptrdiff_t>(settled_), held_.end(),
          [](char32_t a, char32_t b) { return combiningClass(a) < combiningClass(b); });
    }
    settled_ = held_.size();
  }

  std::string_view rest_;
  std::u32string held_;  // what is settled, then what may still move
  std::size_t given_ = 0;
  std::size_t settled_ = 0;
};

bool isFoldedAlike(std::string_view a, std::string_view b) {
  FoldedText foldedA(a);
  FoldedText foldedB(b);
  for (;;) {
    const char32_t next = foldedA.next();
    if (next != foldedB.next()) return false;
    if (next == FoldedText::kEnd) return true;
  }
}

/// Cuts the ASCII characters that both texts begin with.
void cutCommonStart(std::string_view& a, std::string_view& b) noexcept {
  std::size_t same = 0;
  const std::size_t shorter = std::min(a.size(), b.size());
  while (same < shorter && a[same] == b[same] && isASCII(a[same])) ++same;
  a.remove_prefix(same);
  b.remove_prefix(same);
}

/// Cuts the ASCII characters that both texts end with.
void cutCommonEnd(std::string_view& a, std::string_view& b) noexcept {
  while (!a.empty() && !b.empty() && a.back() == b.back() && isASCII(a.back())) {
    a.remove_suffix(1);
    b.remove_suffix(1);
  }
}

}  // namespace

bool isUTF8(std::string_view text) noexcept {
  constexpr std::uint64_t kHighBits = 0x8080808080808080;
  std::uint64_t next = 0;
  while (!text.empty()) {
    if (text.size() >= sizeof next) {
      std::memcpy(&next, text.data(), sizeof next);
      if ((next & kHighBits) == 0) {  // eight of ASCII
        text.remove_prefix(sizeof next);
        continue;
      }
    }
    if (takeCodePoint(text) >= kBeyondUnicode) return false;
  }
  return true;
}

std::u32string withoutDiacritics(std::string_view text) {
  if (std::all_of(text.begin(), text.end(), isASCII)) return {text.begin(), text.end()};
  std::u32string out;
  out.reserve(text.size());
  FoldedText folded(text);
  for (char32_t next = folded.next(); next != FoldedText::kEnd; next = folded.next()) out += next;
  return out;
}

bool isEqualIgnoringDiacriticsWithin(std::string_view a, std::string_view b) {
  // No ASCII character changes or moves, so the texts may be cut beside any of them, and where both
  // have one, or one has it and the other ends, it decides. The ends come first: names that differ
  // in a number do so there.
  cutCommonEnd(a, b);
  const bool isASCIILastInA = a.empty() || isASCII(a.back());
  const bool isASCIILastInB = b.empty() || isASCII(b.back());
  if (isASCIILastInA && isASCIILastInB) return a.empty() && b.empty();
  cutCommonStart(a, b);
  const bool isASCIINextInA = a.empty() || isASCII(a.front());
  const bool isASCIINextInB = b.empty() || isASCII(b.front());
  if (isASCIINextInA && isASCIINextInB) return a.empty() && b.empty();
  return a == b || isFoldedAlike(a, b);
}

bool containsIgnoringCase(std::string_view text, std::string_view part) {
  const auto isSame = [](char a, char b) { return lowerCase(a) == lowerCase(b); };
  return part.empty() ||
         std::search(text.begin(), text.end(), part.begin(), part.end(), isSame) != text.end();
}

}  // namespace nidus
