#include <unicode/normalizer2.h>
#include <unicode/uchar.h>
#include <unicode/utf8.h>

#include <algorithm>
#include <array>
#include <string>
#include <vector>

#include "PlatformModel/System/NDTextMatching.h"
#include "PlatformModel/System/UnicodeTables.h"
#include "Support/Finding.h"

// Text matching against another implementation of the same standard, and against a search that is
// too simple to be wrong. A byte that no text has parts the input into two texts.

namespace nidus {
namespace {

constexpr char kSeparator = '\xFF';
constexpr char32_t kFirstBadByte = 0x110000;

/// Whether our tables know `codePoint` as the other implementation does: the two may be of
/// different versions of the standard.
bool isComparable(UChar32 codePoint) {
  std::array<std::uint8_t, U_MAX_VERSION_LENGTH> age{};
  u_charAge(codePoint, age.data());
  const std::array<std::uint8_t, U_MAX_VERSION_LENGTH> ours = {kUnicodeVersion.major,
                                                               kUnicodeVersion.minor};
  return age[0] != 0 && age <= ours;
}

void appendStripped(std::u32string& out, const icu::UnicodeString& text) {
  UErrorCode status = U_ZERO_ERROR;
  const icu::UnicodeString decomposed =
      icu::Normalizer2::getNFDInstance(status)->normalize(text, status);
  if (U_FAILURE(status)) reportFinding("The other implementation fails.");
  for (std::int32_t at = 0; at < decomposed.length(); at = decomposed.moveIndex32(at, 1)) {
    const UChar32 codePoint = decomposed.char32At(at);
    if (u_charType(codePoint) != U_NON_SPACING_MARK) out += static_cast<char32_t>(codePoint);
  }
}

/// What the other implementation makes of a text. It knows nothing of bytes that are not UTF-8:
/// they part what it is given.
struct Reference {
  explicit Reference(std::string_view text) {
    const auto length = static_cast<std::int32_t>(text.size());
    for (std::int32_t at = 0; at < length;) {
      const std::int32_t begin = at;
      UChar32 codePoint = 0;
      U8_NEXT(text.data(), at, length, codePoint);
      if (codePoint >= 0) {
        isComparableText = isComparableText && isComparable(codePoint);
        run.append(codePoint);
      } else {
        endRun();
        at = begin + 1;
        const auto byte = static_cast<unsigned char>(text[static_cast<std::size_t>(begin)]);
        stripped.push_back(kFirstBadByte + byte);
      }
    }
    endRun();
  }

  void endRun() {
    appendStripped(stripped, run);
    run.remove();
  }

  icu::UnicodeString run;
  std::u32string stripped;
  bool isComparableText = true;
};

std::string decomposed(std::string_view text) {
  UErrorCode status = U_ZERO_ERROR;
  std::string out;
  icu::Normalizer2::getNFDInstance(status)
      ->normalize(icu::UnicodeString::fromUTF8(
                      icu::StringPiece(text.data(), static_cast<std::int32_t>(text.size()))),
                  status)
      .toUTF8String(out);
  return out;
}

void checkEquality(std::string_view a, std::string_view b, bool expected) {
  if (isEqualIgnoringDiacritics(a, b) == expected && isEqualIgnoringDiacritics(b, a) == expected) {
    return;
  }
  reportFinding("\"" + std::string(a) + "\" and \"" + std::string(b) + "\" are " +
                (expected ? "" : "not ") + "equal without diacritics, but taken otherwise.");
}

void checkDiacritics(std::string_view a, std::string_view b) {
  const Reference ofA(a);
  const Reference ofB(b);
  if (!ofA.isComparableText || !ofB.isComparableText) return;
  if (withoutDiacritics(a) != ofA.stripped) {
    reportFinding("\"" + std::string(a) + "\" loses other marks than it should.");
  }
  checkEquality(a, a, true);
  checkEquality(a, b, ofA.stripped == ofB.stripped);
  const bool isUTF8 = std::all_of(ofA.stripped.begin(), ofA.stripped.end(),
                                  [](char32_t each) { return each < kFirstBadByte; });
  if (isUTF8) checkEquality(a, decomposed(a), true);
}

std::string lowerCase(std::string_view text) {
  std::string lower(text);
  for (char& c : lower) {
    if (c >= 'A' && c <= 'Z') c = static_cast<char>(c + ('a' - 'A'));
  }
  return lower;
}

void checkContains(std::string_view text, std::string_view part) {
  const bool expected = lowerCase(text).find(lowerCase(part)) != std::string::npos;
  if (containsIgnoringCase(text, part) == expected) return;
  reportFinding("\"" + std::string(part) + "\" in \"" + std::string(text) + "\" is " +
                (expected ? "missed." : "made up."));
}

/// All characters for which `isWanted`, none of them ASCII.
template <class Test>
std::vector<UChar32> charactersWhere(const Test& isWanted) {
  std::vector<UChar32> found;
  for (UChar32 codePoint = 0x80; codePoint <= UCHAR_MAX_VALUE; ++codePoint) {
    if (isWanted(codePoint)) found.push_back(codePoint);
  }
  return found;
}

bool isMark(UChar32 codePoint) { return u_charType(codePoint) == U_NON_SPACING_MARK; }

/// The kinds of characters in which matching has something to do: those that decompose, the marks
/// that go, and the few that move and stay; beside them letters, at which runs end.
const std::vector<std::vector<UChar32>>& notableCharacters() {
  static const std::vector<std::vector<UChar32>> kCharacters = {
      charactersWhere([](UChar32 codePoint) {
        return u_getIntPropertyValue(codePoint, UCHAR_NFD_QUICK_CHECK) == UNORM_NO;
      }),
      charactersWhere(isMark),
      charactersWhere([](UChar32 codePoint) {
        return u_getCombiningClass(codePoint) != 0 && !isMark(codePoint);
      }),
      {'a', 'E', 0x41F, 0x1100}};
  return kCharacters;
}

/// An input as a text of notable characters, two bytes for each: a kind and one of it.
std::string notableText(std::string_view input) {
  icu::UnicodeString text;
  for (std::size_t i = 0; i + 1 < input.size(); i += 2) {
    const auto number = std::size_t{static_cast<unsigned char>(input[i])} << 8U |
                        static_cast<unsigned char>(input[i + 1]);
    const auto& kind = notableCharacters()[number % notableCharacters().size()];
    text.append(kind[number / notableCharacters().size() % kind.size()]);
  }
  std::string out;
  text.toUTF8String(out);
  return out;
}

void tryTexts(std::string_view input) {
  const std::size_t end = std::min(input.find(kSeparator), input.size());
  const std::string_view a = input.substr(0, end);
  const std::string_view b = input.substr(std::min(end + 1, input.size()));
  checkDiacritics(a, b);
  checkDiacritics(notableText(a), notableText(b));
  checkContains(a, b);
  checkContains(input, b);
}

}  // namespace
}  // namespace nidus

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  nidus::tryTexts(nidus::textOf(data, size));
  return 0;
}
