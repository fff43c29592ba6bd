#include <gtest/gtest.h>
#include <unicode/normalizer2.h>
#include <unicode/uchar.h>

#include <array>
#include <random>
#include <string>
#include <vector>

#include "PlatformModel/System/NDTextMatching.h"
#include "PlatformModel/System/UnicodeTables.h"

// The tables against another implementation of the same standard, over all of Unicode.

namespace nidus {
namespace {

constexpr char32_t kCodePointEnd = 0x110000;

/// What the other implementation makes of `text`.
std::u32string expected(const icu::UnicodeString& text) {
  UErrorCode status = U_ZERO_ERROR;
  const icu::Normalizer2* decomposer = icu::Normalizer2::getNFDInstance(status);
  const icu::UnicodeString decomposed = decomposer->normalize(text, status);
  EXPECT_TRUE(U_SUCCESS(status));
  std::u32string kept;
  for (std::int32_t at = 0; at < decomposed.length(); at = decomposed.moveIndex32(at, 1)) {
    const UChar32 codePoint = decomposed.char32At(at);
    if (u_charType(codePoint) == U_NON_SPACING_MARK) continue;
    kept += static_cast<char32_t>(codePoint);
  }
  return kept;
}

std::u32string actual(const icu::UnicodeString& text) {
  std::string utf8;
  text.toUTF8String(utf8);
  return withoutDiacritics(utf8);
}

/// Whether our tables know `codePoint` as the other implementation does: the two may be of
/// different versions of the standard, and only what both have can be compared.
bool isComparable(char32_t codePoint) {
  if (codePoint >= 0xD800 && codePoint <= 0xDFFF) return false;  // not a character of any text
  std::array<std::uint8_t, U_MAX_VERSION_LENGTH> theirs{};
  u_getUnicodeVersion(theirs.data());
  std::array<std::uint8_t, U_MAX_VERSION_LENGTH> age{};
  u_charAge(static_cast<UChar32>(codePoint), age.data());
  const std::array<std::uint8_t, U_MAX_VERSION_LENGTH> ours = {kUnicodeVersion.major,
                                                               kUnicodeVersion.minor};
  if (theirs == ours) return true;
  return age[0] != 0 && age <= ours;
}

std::vector<UChar32> codePointsWhere(bool (*isWanted)(UChar32 codePoint)) {
  std::vector<UChar32> found;
  for (char32_t codePoint = 0; codePoint < kCodePointEnd; ++codePoint) {
    const auto candidate = static_cast<UChar32>(codePoint);
    if (isComparable(codePoint) && isWanted(candidate)) found.push_back(candidate);
  }
  return found;
}

TEST(WithoutDiacriticsUnicodeTest, EveryCodePointIsAsInICU) {
  int compared = 0;
  for (char32_t codePoint = 0; codePoint < kCodePointEnd; ++codePoint) {
    if (!isComparable(codePoint)) continue;
    const icu::UnicodeString text(static_cast<UChar32>(codePoint));
    ASSERT_EQ(actual(text), expected(text)) << std::hex << std::uint32_t{codePoint};
    ++compared;
  }
  EXPECT_GT(compared, 280000);
}

// What stays of a run of combining characters is in the order of their classes, however they came.
TEST(WithoutDiacriticsUnicodeTest, MarksMoveAsInICU) {
  const auto combining =
      codePointsWhere([](UChar32 codePoint) { return u_getCombiningClass(codePoint) != 0; });
  const auto staying = codePointsWhere([](UChar32 codePoint) {
    return u_getCombiningClass(codePoint) != 0 && u_charType(codePoint) != U_NON_SPACING_MARK;
  });
  ASSERT_GT(combining.size(), 800U);
  ASSERT_GT(staying.size(), 20U);
  for (const UChar32 first : staying) {
    for (const UChar32 second : staying) {
      for (std::size_t at = 0; at < combining.size(); at += 7) {
        const icu::UnicodeString text =
            icu::UnicodeString(u'a').append(first).append(combining[at]).append(second);
        ASSERT_EQ(actual(text), expected(text)) << std::hex << first << ' ' << second;
      }
    }
  }
}

TEST(WithoutDiacriticsUnicodeTest, RandomTextsAreAsInICU) {
  const auto decomposing = codePointsWhere([](UChar32 codePoint) {
    return u_getIntPropertyValue(codePoint, UCHAR_NFD_QUICK_CHECK) == UNORM_NO;
  });
  const auto marks = codePointsWhere([](UChar32 codePoint) {
    return u_getCombiningClass(codePoint) != 0 || u_charType(codePoint) == U_NON_SPACING_MARK;
  });
  ASSERT_GT(decomposing.size(), 13000U);  // Hangul syllables included
  ASSERT_GT(marks.size(), 1900U);
  std::minstd_rand random(20221);
  for (int round = 0; round < 20000; ++round) {
    icu::UnicodeString text;
    for (int piece = 0; piece < 6; ++piece) {
      const auto& from = random() % 3 == 0 ? decomposing : marks;
      text.append(from[random() % from.size()]);
    }
    ASSERT_EQ(actual(text), expected(text)) << "round " << round;
  }
}

TEST(WithoutDiacriticsUnicodeTest, MarkWithoutClassStopsTheOthers) {
  const icu::UnicodeString apart = icu::UnicodeString(u'a')
                                       .append(UChar32{0x1D16D})
                                       .append(UChar32{0x034F})
                                       .append(UChar32{0x1D165});
  const icu::UnicodeString together =
      icu::UnicodeString(u'a').append(UChar32{0x1D16D}).append(UChar32{0x1D165});
  EXPECT_EQ(actual(apart), expected(apart));
  EXPECT_NE(actual(apart), actual(together));
}

}  // namespace
}  // namespace nidus
