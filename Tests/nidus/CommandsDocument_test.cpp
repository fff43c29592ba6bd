#include <cstdlib>
#include <fstream>

#include "nidus/CommandExamples.h"
#include "nidus/ProgramTest.h"

namespace nidus {
namespace {

constexpr const char kTitle[] = R"(# Commands

What a person types, and what the program answers. Each answer below was given by the program: the
orders run one after the other on the demonstration home and on a home whose devices do not do what
they are told (at the end of this document). A test of the project runs them all again and compares;
`NIDUS_WRITE_DOCUMENTS=1` lets it write this document anew.

The words for attributes, values and types are in `nidus vocabulary`. What an order would do, and
why it comes to nothing, is told by `nidus explain` before the same words.
)";

/// A word as it has to be typed.
std::string typed(const std::string& word) {
  return word.find(' ') == std::string::npos ? word : '"' + word + '"';
}

class CommandsDocumentTest : public ProgramTest {
 protected:
  [[nodiscard]] std::string document() const {
    std::string text = kTitle;
    for (const CommandChapter& chapter : commandChapters()) text += chapterText(chapter);
    return text + "\n## The home with faults\n\n```json\n" + workshopHome() + "```\n";
  }

 private:
  [[nodiscard]] std::string chapterText(const CommandChapter& chapter) const {
    std::string text = "\n## " + chapter.title + '\n';
    if (!chapter.text.empty()) text += '\n' + chapter.text + '\n';
    for (const CommandExample& example : chapter.examples) text += exampleText(example);
    return text;
  }

  [[nodiscard]] std::string exampleText(const CommandExample& example) const {
    std::string text = '\n' + example.text + "\n\n```console\n$ ";
    if (!example.input.empty()) text += "echo '" + example.input + "' | ";
    text += "nidus";
    for (const std::string& word : example.line) text += ' ' + typed(word);
    ProgramStart order = start(example.line, example.input);
    order.environment = {{"LC_ALL", "C.UTF-8"}};
    const ProgramEnd end = runProgram(order);
    return text + '\n' + end.errors + end.output + "```\n";
  }
};

TEST_F(CommandsDocumentTest, TellsWhatTheProgramAnswers) {
  const std::string demonstration = std::string(NIDUS_RESOURCES) + "/demonstration-home.json";
  ASSERT_EQ(run({"home", "import", demonstration}).exitStatus, 0);
  ASSERT_EQ(
      run({"home", "import", "--merge", folder_.write("faults.json", workshopHome())}).exitStatus,
      0);
  const std::string now = document();
  const std::string file = std::string(NIDUS_DOCUMENTATION) + "/Commands.md";
  if (std::getenv("NIDUS_WRITE_DOCUMENTS")) std::ofstream(file) << now;
  EXPECT_EQ(contentOfFile(file), now);
}

/// What an example has to show is in its answer.
TEST_F(CommandsDocumentTest, NamesEachActionAndOutcome) {
  const std::string text = contentOfFile(std::string(NIDUS_DOCUMENTATION) + "/Commands.md");
  for (const char* word : {"GET",
                           "GET_TARGET_VALUE",
                           "GET_MINIMUM",
                           "GET_MAXIMUM",
                           "GET_STEP_VALUE",
                           "SET",
                           "SET_TO_MINIMUM",
                           "SET_TO_MAXIMUM",
                           "INCREASE",
                           "DECREASE",
                           "TOGGLE",
                           "COMMAND_SUCCESS",
                           "COMMAND_FAILURE",
                           "FOUND_NO_MATCHING_ENTITIES",
                           "REQUIRES_UNLOCK",
                           "SUCCESS",
                           "FAILURE",
                           "READ_ONLY",
                           "UNREACHABLE",
                           "--home",
                           "--room",
                           "--zone",
                           "--group",
                           "--service",
                           "--scene",
                           "--type",
                           "--entity"}) {
    EXPECT_THAT(text, testing::HasSubstr(std::string("`") + word + '`'));
  }
}

}  // namespace
}  // namespace nidus
