#include "nidus/Shell/LineWords.h"

#include <gmock/gmock.h>

namespace nidus {
namespace {

using ::testing::HasSubstr;

TEST(LineWordsTest, TakesWordsApartAsAShellDoes) {
  const struct {
    const char* line;
    std::vector<std::string> words;
  } table[] = {
      {"", {}},
      {"  \t ", {}},
      {" get  power ", {"get", "power"}},
      {"run 'Good night'", {"run", "Good night"}},
      {R"(run "Good night")", {"run", "Good night"}},
      {R"(run Good\ night)", {"run", "Good night"}},
      {R"(a"b c"'d e'f)", {"ab cd ef"}},
      {R"('' "")", {"", ""}},
      {R"('\ ' "\ \"\\\$")", {"\\ ", "\\ \"\\$"}},
      {R"("it's" '"')", {"it's", "\""}},
      {"run Café # the corner", {"run", "Café"}},
      {"run a#b \\#c", {"run", "a#b", "#c"}},
      {"# nothing", {}},
  };
  for (const auto& [line, words] : table) {
    SCOPED_TRACE(line);
    const auto result = wordsOf(line);
    ASSERT_TRUE(result);
    EXPECT_EQ(*result, words);
  }
}

TEST(LineWordsTest, RefusesWhatIsNotClosed) {
  EXPECT_THAT(wordsOf("run 'Good").failure().message, HasSubstr("close it with '"));
  EXPECT_THAT(wordsOf("run \"it's").failure().message, HasSubstr("close it with \""));
  EXPECT_THAT(wordsOf("run \\").failure().message, HasSubstr("backslash"));
}

TEST(LineWordsTest, KeepsTheUnfinishedWordAsTyped) {
  const struct {
    const char* line;
    std::vector<std::string> words;
    const char* typed;
    char quote;
  } table[] = {
      {"", {""}, "", 0},
      {"get ", {"get", ""}, "", 0},
      {"get po", {"get", "po"}, "po", 0},
      {"run 'Good n", {"run", "Good n"}, "'Good n", '\''},
      {R"(run G"ood)", {"run", "Good"}, R"(G"ood)", '"'},
      {R"(run Good\ n)", {"run", "Good n"}, R"(Good\ n)", 0},
      {R"(run Good\)", {"run", "Good"}, "Good", 0},
  };
  for (const auto& [line, words, typed, quote] : table) {
    SCOPED_TRACE(line);
    const UnfinishedLine unfinished = unfinishedLineOf(line);
    EXPECT_EQ(unfinished.words, words);
    EXPECT_EQ(unfinished.typed, typed);
    EXPECT_EQ(unfinished.quote, quote);
  }
}

TEST(LineWordsTest, QuotesAsTheWordWasBegun) {
  const struct {
    const char* line;
    const char* word;
    const char* typed;
  } table[] = {
      {"run Ca", "Café Corner", R"(Café\ Corner)"},
      {"run ", "it's 5:00", R"(it\'s\ 5\:00)"},
      {"run 'it", "it's", R"('it'\''s)"},
      {R"(run "Ca)", "Café Corner", R"("Café Corner)"},
      {R"(run "a)", R"(a"$`\b)", R"("a\"\$\`\\b)"},
      {"run cafe", "Café Corner", R"(Café\ Corner)"},
      {"run 'cafe", "Café Corner", "'Café Corner"},
      {"run --room=Ca", "--room=Café Corner", R"(--room=Café\ Corner)"},
      {R"(run Good\ n)", "Good night", R"(Good\ night)"},
  };
  for (const auto& [line, word, typed] : table) {
    SCOPED_TRACE(line);
    const std::string result = typedFormOf(word, unfinishedLineOf(line));
    EXPECT_EQ(result, typed);
    const auto read =
        wordsOf("run " + result +
                (result.front() == '\'' || result.front() == '"' ? std::string(1, result.front())
                                                                 : std::string()));
    ASSERT_TRUE(read);
    EXPECT_EQ(read->back(), word);
  }
}

}  // namespace
}  // namespace nidus
