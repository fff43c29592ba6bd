#include "nidus/Shell/LineCompletion.h"

#include <gmock/gmock.h>

#include <filesystem>

#include "Support/TestFolder.h"

namespace nidus {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;

TEST(LineCompletionTest, CompletesAndClosesTheOnlyWord) {
  const struct {
    const char* line;
    std::size_t replaced;
    const char* text;
  } table[] = {
      {"run ", 0, R"(Café\ Corner )"},     {"run Ca", 2, R"(Café\ Corner )"},
      {"run 'Ca", 3, "'Café Corner' "},    {R"(run "Café C)", 8, R"("Café Corner" )"},
      {"run cafe", 4, R"(Café\ Corner )"},
  };
  for (const auto& [line, replaced, text] : table) {
    SCOPED_TRACE(line);
    const LineCompletion completion = lineCompletion(line, {"Café Corner"});
    EXPECT_EQ(completion.replaced, replaced);
    EXPECT_EQ(completion.text, text);
    EXPECT_THAT(completion.choices, IsEmpty());
  }
}

TEST(LineCompletionTest, CompletesAsFarAsWordsAgree) {
  const LineCompletion completion = lineCompletion("run K", {"Kitchen door", "Kitchen lamp"});
  EXPECT_EQ(completion.replaced, 1U);
  EXPECT_EQ(completion.text, R"(Kitchen\ )");
}

TEST(LineCompletionTest, ShowsChoicesThatPartHere) {
  const LineCompletion completion = lineCompletion("run Kit", {"Kite", "Kitten"});
  EXPECT_THAT(completion.text, IsEmpty());
  EXPECT_THAT(completion.choices, ElementsAre("Kite", "Kitten"));
}

TEST(LineCompletionTest, KeepsCharactersWhole) {
  // The first bytes of the two letters are equal.
  EXPECT_EQ(lineCompletion("run C", {"Café", "Cafè"}).text, "Caf");
}

TEST(LineCompletionTest, DoesNothingWithoutWords) {
  const LineCompletion completion = lineCompletion("run x", {});
  EXPECT_THAT(completion.text, IsEmpty());
  EXPECT_THAT(completion.choices, IsEmpty());
}

TEST(LineCompletionTest, LeavesAFolderOpen) {
  EXPECT_EQ(lineCompletion("home import 'My", {"My homes/"}).text, "'My homes/");
}

TEST(FileCompletionTest, FindsFilesAndFoldersByTheirStart) {
  const TestFolder folder;
  folder.write("home.json", "");
  std::filesystem::create_directory(folder.path() / "homes");
  folder.write("homes/one.json", "");
  folder.write(".hidden", "");
  const std::string path = folder.path().string();
  EXPECT_THAT(filesThatBeginWith(path + "/"), ElementsAre(path + "/home.json", path + "/homes/"));
  EXPECT_THAT(filesThatBeginWith(path + "/homes/o"), ElementsAre(path + "/homes/one.json"));
  EXPECT_THAT(filesThatBeginWith(path + "/."), ElementsAre(path + "/.hidden"));
  EXPECT_THAT(filesThatBeginWith(path + "/none/"), IsEmpty());
}

}  // namespace
}  // namespace nidus
