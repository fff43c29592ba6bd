#pragma once

#include <string>
#include <string_view>

#include "PlatformModel/System/NDExport.h"

namespace nidus {

/// As below, for texts whose ends do not tell them apart.
[[nodiscard]] ND_EXPORT bool isEqualIgnoringDiacriticsWithin(std::string_view a,
                                                             std::string_view b);

/// Says whether two UTF-8 texts are equal when diacritics are ignored, letter case kept: after
/// canonical decomposition and removal of the nonspacing marks. Bytes that are not UTF-8 match
/// only themselves. May be called from any thread; allocates nothing when both texts are ASCII.
[[nodiscard]] inline bool isEqualIgnoringDiacritics(std::string_view a, std::string_view b) {
  // No ASCII character changes or moves, so two different ones at the ends decide; the names of a
  // home mostly differ there.
  const bool haveEnds = !a.empty() && !b.empty();
  if (haveEnds && a.back() != b.back() && ((a.back() | b.back()) & 0x80) == 0) return false;
  return isEqualIgnoringDiacriticsWithin(a, b);
}

/// Gives what is compared when diacritics are ignored: the code points of the canonical
/// decomposition of a UTF-8 text, without the nonspacing marks. A byte that is not UTF-8 becomes
/// 0x110000 plus its value. May be called from any thread.
[[nodiscard]] ND_EXPORT std::u32string withoutDiacritics(std::string_view text);

/// Says whether a text is UTF-8. May be called from any thread.
[[nodiscard]] ND_EXPORT bool isUTF8(std::string_view text) noexcept;

/// Says whether `text` contains `part` when the case of ASCII letters is ignored. The empty part
/// is contained in every text. May be called from any thread.
[[nodiscard]] ND_EXPORT bool containsIgnoringCase(std::string_view text, std::string_view part);

}  // namespace nidus
