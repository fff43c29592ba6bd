#include "PlatformModel/System/NDTextMatching.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace nidus {
namespace {

struct Match {
  const char* label;
  std::string a;
  std::string b;
  bool isEqual;
};

std::vector<Match> matches() {
  return {
      {"same", "Kitchen", "Kitchen", true},
      {"empty", "", "", true},
      {"letter case counts", "Cafe", "cafe", false},
      {"accent", "Cafe", "Caf\u00E9", true},
      {"accent and case", "cafe", "Caf\u00C9", false},
      {"two forms", "Caf\u00E9", "Cafe\u0301", true},
      {"other accent", "Caf\u00E9", "Caf\u00E8", true},
      {"mark alone", "\u0301", "", true},
      {"marks in the middle", "a\u0301\u0323b", "ab", true},
      {"longer", "Kitchen", "Kitchens", false},
      {"shorter with accent", "Caf\u00E9", "Caf", false},
      {"other number after an accent", "Caf\u00E9 1", "Cafe 2", false},
      {"same number after an accent", "Caf\u00E9 12", "Cafe 12", true},
      {"mark before a common end", "Cafe\u0301 1", "Cafe 1", true},
      {"mark before a common text", "\u0301Cafe", "Cafe", true},
      {"letters between accents differ", "\u00E9a\u00E9", "\u00E9b\u00E9", false},
      {"letters after the start differ", "a\u00E9", "b\u00E9", false},
      {"accent against the end", "Caf\u00E9", "Caf", false},
      {"accent against nothing", "\u00E9", "", false},
      {"one goes on after accents", "\u00E9b\u00E9", "\u00E9", false},
      {"start and end overlap", "aa", "aaa", false},
      {"start and end overlap at an accent", "aa\u0301a", "aa", false},
      {"nested decomposition", "\u1EAD", "a", true},
      {"stroke is no mark", "\u00D8", "O", false},
      {"sharp s is no ss", "\u00DF", "ss", false},
      {"ligature is compatibility only", "\uFB01", "fi", false},
      {"width is compatibility only", "\uFF21", "A", false},
      {"singleton", "\u212B", "A", true},
      {"ohm", "\u2126", "\u03A9", true},
      {"Hangul with two parts", "\uAC00", "\u1100\u1161", true},
      {"Hangul with three parts", "\uAC01", "\u1100\u1161\u11A8", true},
      {"last Hangul syllable", "\uD7A3", "\u1112\u1175\u11C2", true},
      {"Hangul syllables differ", "\uAC00", "\uAC01", false},
      {"spacing mark stays", "\u0915\u093E", "\u0915", false},
      {"nonspacing vowel goes", "\u0915\u0941", "\u0915", true},
      {"beyond 16 bits", "\U0001F3E0", "\U0001F3E0", true},
      {"decomposes beyond 16 bits", "\U0001D15E", "\U0001D157\U0001D165", true},
  };
}

TEST(IsEqualIgnoringDiacriticsTest, ComparesBaseCharactersAlone) {
  for (const Match& match : matches()) {
    SCOPED_TRACE(match.label);
    EXPECT_EQ(isEqualIgnoringDiacritics(match.a, match.b), match.isEqual);
    EXPECT_EQ(isEqualIgnoringDiacritics(match.b, match.a), match.isEqual);
  }
}

std::vector<std::string> malformedTexts() {
  return {"\xFF",     "\x80",         "\xC3",         "\xE2\x82",         "\xF0\x9F\x8F",
          "\xC0\xAF", "\xE0\x80\xAF", "\xED\xA0\x80", "\xF4\x90\x80\x80", "\xF8\x88\x80\x80\x80",
          "\xC3(",    "\xCC"};
}

TEST(IsEqualIgnoringDiacriticsTest, MalformedBytesMatchOnlyThemselves) {
  for (const std::string& malformed : malformedTexts()) {
    EXPECT_TRUE(isEqualIgnoringDiacritics("a" + malformed, "a\u0301" + malformed));
    EXPECT_FALSE(isEqualIgnoringDiacritics("a" + malformed, "a"));
    for (const std::string& other : malformedTexts()) {
      EXPECT_EQ(isEqualIgnoringDiacritics(malformed, other), malformed == other);
    }
  }
}

TEST(IsEqualIgnoringDiacriticsTest, MalformedBytesMatchNoReplacement) {
  EXPECT_FALSE(isEqualIgnoringDiacritics("\xFF", "\uFFFD"));
  EXPECT_FALSE(isEqualIgnoringDiacritics("\xE9", "\u00E9"));
}

TEST(WithoutDiacriticsTest, MalformedBytesLieBeyondUnicode) {
  EXPECT_EQ(withoutDiacritics("\xC3(\xCC\x81"), (std::u32string{0x1100C3, U'('}));
}

TEST(WithoutDiacriticsTest, KeepsOrderOfManyMarksThatStay) {
  // Marks that take room, of the classes 216 and 226: the latter go behind all of the former.
  std::string text = "a";
  for (int i = 0; i < 20; ++i) text += "\U0001D16D\u0323\U0001D165";
  const std::u32string expected =
      U"a" + std::u32string(20, U'\U0001D165') + std::u32string(20, U'\U0001D16D');
  EXPECT_EQ(withoutDiacritics(text + "b"), expected + U"b");
  EXPECT_EQ(withoutDiacritics(text), expected);
}

TEST(WithoutDiacriticsTest, KeepsAsciiAsItIs) {
  std::string ascii;
  for (char c = 0; c < 0x7F; ++c) ascii += c;
  EXPECT_EQ(withoutDiacritics(ascii), std::u32string(ascii.begin(), ascii.end()));
}

struct Containment {
  const char* label;
  std::string text;
  std::string part;
  bool isContained;
};

std::vector<Containment> containments() {
  return {
      {"empty part", "text", "", true},
      {"both empty", "", "", true},
      {"empty text", "", "a", false},
      {"other case", "x-corvane-nidus://local/home?id=9E01A3C4", "9e01a3c4", true},
      {"at the start", "ABC", "ab", true},
      {"at the end", "ABC", "bC", true},
      {"after a false start", "aab", "AB", true},
      {"longer than text", "ab", "abc", false},
      {"absent", "abc", "ac", false},
      {"ASCII letters alone are folded", "\u00C9", "\u00E9", false},
      {"neighbours of letters differ", "@[", "`{", false},
  };
}

TEST(ContainsIgnoringCaseTest, FoldsAsciiLettersAlone) {
  for (const Containment& containment : containments()) {
    SCOPED_TRACE(containment.label);
    EXPECT_EQ(containsIgnoringCase(containment.text, containment.part), containment.isContained);
  }
}

TEST(IsUTF8Test, TakesWholeSequencesOfScalarsAlone) {
  for (const char* text : {"", "Kitchen", "Beach House", "K\u00FCche", "K\u00FCche im Haus",
                           "\uFFFF", "\U00010000", "\U0010FFFF"}) {
    EXPECT_TRUE(isUTF8(text)) << text;
  }
  for (const char* text : {"\xFF", "Kitchen \xE9 of", "\xC3", "eight by\xC3", "\xC0\x80",
                           "\xED\xA0\x80", "\xF4\x90\x80\x80", "\x80 begins"}) {
    EXPECT_FALSE(isUTF8(text)) << text;
  }
}

}  // namespace
}  // namespace nidus
