#include "PlatformModel/System/NDTextMatching.h"

#include <algorithm>
#include <cstdint>

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

constexpr bool isScalarOfLength(char32_t codePoint, std::size_t length) noexcept {
  constexpr char32_t kLeastOfLength[] = {0, 0, 0x80, 0x800, 0x10000};
  return codePoint >= kLeastOfLength[length] && codePoint < 0x110000 &&
         (codePoint < 0xD800 || codePoint > 0xDFFF);
}

/// A byte that is not UTF-8 becomes a number beyond all code points, so it matches itself alone.
char32_t takeByte(std::string_view& text) noexcept {
  const auto byte = static_cast<unsigned char>(text.front());
  text.remove_prefix(1);
  return 0x110000U + byte;
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

/// Hangul syllables are built from their parts by a rule, which is part of the Unicode standard.
bool appendHangul(std::u32string& out, char32_t codePoint) {
  constexpr char32_t kFirstSyllable = 0xAC00;
  constexpr char32_t kLeadBase = 0x1100;
  constexpr char32_t kVowelBase = 0x1161;
  constexpr char32_t kTrailBase = 0x11A7;
  constexpr char32_t kVowels = 21;
  constexpr char32_t kTrails = 28;
  constexpr char32_t kSyllables = 19 * kVowels * kTrails;
  if (codePoint < kFirstSyllable || codePoint >= kFirstSyllable + kSyllables) return false;
  const char32_t index = codePoint - kFirstSyllable;
  out.push_back(kLeadBase + index / (kVowels * kTrails));
  out.push_back(kVowelBase + index / kTrails % kVowels);
  if (index % kTrails != 0) out.push_back(kTrailBase + index % kTrails);
  return true;
}

void appendDecomposition(std::u32string& out, char32_t codePoint) {
  if (appendHangul(out, codePoint)) return;
  const auto entry = std::lower_bound(
      kDecompositions.begin(), kDecompositions.end(), codePoint,
      [](const Decomposition& candidate, char32_t wanted) { return candidate.codePoint < wanted; });
  if (entry == kDecompositions.end() || entry->codePoint != codePoint) {
    out += codePoint;
    return;
  }
  const auto parts = kDecompositionPool.subspan(entry->offset, entry->length);
  out.append(parts.begin(), parts.end());
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

bool isNonspacingMark(char32_t codePoint) noexcept {
  const CombiningRange* range = combiningRange(codePoint);
  return range && range->isNonspacingMark;
}

/// Puts each run of combining characters into the order of their classes.
void reorder(std::u32string& text) {
  const auto isStarter = [](char32_t codePoint) { return combiningClass(codePoint) == 0; };
  const auto isBefore = [](char32_t a, char32_t b) {
    return combiningClass(a) < combiningClass(b);
  };
  auto begin = text.begin();
  while (begin != text.end()) {
    begin = std::find_if_not(begin, text.end(), isStarter);
    const auto end = std::find_if(begin, text.end(), isStarter);
    std::stable_sort(begin, end, isBefore);
    begin = end;
  }
}

}  // namespace

std::u32string withoutDiacritics(std::string_view text) {
  std::u32string out;
  out.reserve(text.size());
  while (!text.empty()) appendDecomposition(out, takeCodePoint(text));
  // Before the marks go: a mark without a class keeps others from moving past it.
  reorder(out);
  std::erase_if(out, isNonspacingMark);
  return out;
}

bool isEqualIgnoringDiacritics(std::string_view a, std::string_view b) {
  // No ASCII character changes or moves, so the texts may be cut after any of them.
  std::size_t same = 0;
  const std::size_t shorter = std::min(a.size(), b.size());
  while (same < shorter && a[same] == b[same] && isASCII(a[same])) ++same;
  a.remove_prefix(same);
  b.remove_prefix(same);
  const bool isASCIINextInA = a.empty() || isASCII(a.front());
  const bool isASCIINextInB = b.empty() || isASCII(b.front());
  if (isASCIINextInA && isASCIINextInB) return a.empty() && b.empty();
  return a == b || withoutDiacritics(a) == withoutDiacritics(b);
}

bool containsIgnoringCase(std::string_view text, std::string_view part) {
  const auto isSame = [](char a, char b) { return lowerCase(a) == lowerCase(b); };
  return part.empty() ||
         std::search(text.begin(), text.end(), part.begin(), part.end(), isSame) != text.end();
}

}  // namespace nidus
