#include "nidus/Terminal/Terminal.h"

#include <gtest/gtest.h>

namespace nidus {
namespace {

struct WidthCase {
  const char* label;
  std::string text;
  std::size_t cells;
};

TEST(CellsOfTest, CountsWideAndCombiningCharacters) {
  const WidthCase table[] = {
      {"nothing", "", 0},
      {"letters", "Lamp", 4},
      {"composed accent", "Caf\u00e9", 4},
      {"decomposed accent", "Cafe\u0301", 4},
      {"wide characters", "日本語", 6},
      {"wide and narrow", "灯 1", 4},
      {"emoji", "💡", 2},
      {"zero width joiner and space", "a\u200d\u200bb", 2},
      {"half-width kana", "ｱ", 1},
      {"box drawing", "└─", 2},
  };
  for (const WidthCase& width : table) {
    SCOPED_TRACE(width.label);
    EXPECT_EQ(cellsOf(width.text), width.cells);
  }
}

struct ShorteningCase {
  const char* label;
  std::string text;
  std::size_t cells;
  std::string shortened;
};

TEST(ShortenedTest, KeepsWithinTheCells) {
  const ShorteningCase table[] = {
      {"fits", "Lamp", 4, "Lamp"},
      {"one too long", "Lamps", 4, "Lam…"},
      {"one cell", "Lamps", 1, "…"},
      {"no cell", "Lamps", 0, ""},
      {"nothing", "", 0, ""},
      {"accent stays with its letter", "Cafe\u0301 Lamp", 5, "Cafe\u0301…"},
      {"no half of a wide character", "日本語", 4, "日…"},
      {"wide ones to the end", "日本語", 5, "日本…"},
      {"wide ones fit", "日本語", 6, "日本語"},
      {"joined emoji stay together", "👩\u200d🔧 Workshop", 4, "…"},
  };
  for (const ShorteningCase& shortening : table) {
    SCOPED_TRACE(shortening.label);
    EXPECT_EQ(shortened(shortening.text, shortening.cells), shortening.shortened);
  }
}

struct WrappingCase {
  const char* label;
  std::string text;
  std::size_t cells;
  std::vector<std::string> lines;
};

TEST(WrappedTest, BreaksAtBlanks) {
  const WrappingCase table[] = {
      {"nothing", "", 5, {""}},
      {"fits", "on, off", 7, {"on, off"}},
      {"one too long", "on, off", 6, {"on,", "off"}},
      {"several", "a b c d e", 3, {"a b", "c d", "e"}},
      {"no blank", "brightness", 3, {"brightness"}},
      {"long word within", "a brightness b", 4, {"a", "brightness", "b"}},
      {"wide characters", "日本 語", 5, {"日本", "語"}},
      {"without limits", "on, off", 0, {"on, off"}},
  };
  for (const WrappingCase& wrapping : table) {
    SCOPED_TRACE(wrapping.label);
    EXPECT_EQ(wrapped(wrapping.text, wrapping.cells), wrapping.lines);
  }
}

TEST(ColouredTest, ColoursOnlyWhereThereAreColours) {
  const TerminalStyle plain;
  const TerminalStyle colourful = {true, 80};
  EXPECT_EQ(coloured("ok", Colour::good, plain), "ok");
  EXPECT_EQ(coloured("ok", Colour::good, colourful), "\x1b[32mok\x1b[0m");
  EXPECT_EQ(coloured("ok", Colour::none, colourful), "ok");
  EXPECT_EQ(coloured("", Colour::bad, colourful), "");
}

}  // namespace
}  // namespace nidus
