#pragma once

#include <cstdint>
#include <span>

#include "PlatformModel/System/NDExport.h"

namespace nidus {

/// The version of the Unicode character database that the tables come from.
struct UnicodeVersion {
  std::uint8_t major;
  std::uint8_t minor;
};

/// Neighbouring code points that share their combining class and are, or are not, nonspacing marks.
struct CombiningRange {
  char32_t first;
  char32_t last;                ///< Included.
  std::uint8_t combiningClass;  ///< The canonical combining class.
  bool isNonspacingMark;        ///< Whether the general category is Mn.
};

/// The full canonical decomposition of one code point.
struct Decomposition {
  char32_t codePoint;
  std::uint16_t offset;  ///< Where it begins in the pool.
  std::uint16_t length;  ///< How many code points it has.
};

extern ND_EXPORT const UnicodeVersion kUnicodeVersion;
/// In the order of the code points; one that is in no range has class 0 and is no nonspacing mark.
extern const std::span<const CombiningRange> kCombiningRanges;
/// In the order of the code points; without the Hangul syllables, which decompose by a rule.
extern const std::span<const Decomposition> kDecompositions;
extern const std::span<const char32_t> kDecompositionPool;

}  // namespace nidus
