#include "HomePlatform/System/OneLine.h"

#include <gtest/gtest.h>

namespace nidus {
namespace {

struct LineCase {
  const char* label;
  std::string_view text;
  const char* line;
};

TEST(OnOneLineTest, ShowsControlCharactersAsEscapes) {
  const LineCase table[] = {
      {"nothing", "", ""},
      {"letters", "Chloé's 灯 💡", "Chloé's 灯 💡"},
      {"end of line", "a\r\nb", "a\\x0d\\x0ab"},
      {"escape", "\x1b[2J", "\\x1b[2J"},
      {"delete", "\x7f", "\\x7f"},
      {"first of the second set", "\xc2\x80", "\\xc2\\x80"},
      {"last of the second set", "\xc2\x9f!", "\\xc2\\x9f!"},
      {"after the second set", "\u00a0\u00e9", "\u00a0\u00e9"},
      {"half a character", "\xc2", "\xc2"},
  };
  for (const LineCase& item : table) {
    SCOPED_TRACE(item.label);
    EXPECT_EQ(onOneLine(item.text), item.line);
  }
}

}  // namespace
}  // namespace nidus
