#include "nidus/ProgramTest.h"
#include "nidus/TerminalProcess.h"

namespace nidus {
namespace {

using ::testing::AllOf;
using ::testing::HasSubstr;
using ::testing::IsEmpty;

/// The answer to one order, on the small home.
class AnswerOutputTest : public ProgramTest {
 protected:
  void SetUp() override { importSmallHome(); }
  [[nodiscard]] ProgramStart ask() const {
    return start({"get", "brightness", "--room", "Kitchen"});
  }
};

constexpr const char kPlainAnswer[] =
    "OBJECT  ROOM     HOME     BRIGHTNESS  OUTCOME\n"
    "Lamp    Kitchen  Cottage  40 %        ok\n"
    "Away    Kitchen  Cottage              unreachable\n"
    "1 light read, 1 unreachable: Away\n";

TEST_F(AnswerOutputTest, IsPlainInAPipe) {
  const ProgramEnd end = runProgram(ask());
  EXPECT_EQ(end.output, kPlainAnswer);
  EXPECT_THAT(end.errors, IsEmpty());
}

TEST_F(AnswerOutputTest, HasColourAndSymbolsOnATerminal) {
  const ProgramEnd end = runOnTerminal(ask());
  EXPECT_EQ(end.exitStatus, 0);
  EXPECT_THAT(end.output, AllOf(HasSubstr("\x1b[1mOBJECT\x1b[0m"), HasSubstr("\x1b[32m✓ ok\x1b[0m"),
                                HasSubstr("\x1b[31m✗ unreachable\x1b[0m")));
}

TEST_F(AnswerOutputTest, HasNoColourWhereNoneIsWanted) {
  ProgramStart refused = ask();
  refused.environment["NO_COLOR"] = "1";
  EXPECT_EQ(runOnTerminal(refused).output, kPlainAnswer);
  for (const auto& terminal : {std::optional<std::string>("dumb"), {}}) {
    ProgramStart simple = ask();
    simple.environment["TERM"] = terminal;
    EXPECT_EQ(runOnTerminal(simple).output, kPlainAnswer);
  }
}

TEST_F(AnswerOutputTest, TakesAnEmptyRefusalForNone) {
  ProgramStart start = ask();
  start.environment["NO_COLOR"] = "";
  EXPECT_THAT(runOnTerminal(start).output, HasSubstr("\x1b["));
}

TEST_F(AnswerOutputTest, HasNoColourInAFileWhenStartedOnATerminal) {
  ProgramStart redirected = ask();
  redirected.outputFile = folder_.file("output");
  EXPECT_THAT(runOnTerminal(redirected).output, IsEmpty());
  EXPECT_EQ(contentOfFile(redirected.outputFile), kPlainAnswer);
}

TEST_F(AnswerOutputTest, FitsANarrowTerminal) {
  ProgramStart plain = ask();
  plain.environment["NO_COLOR"] = "1";
  EXPECT_EQ(runOnTerminal(plain, 40).output,
            "OBJECT  ROOM    HOME    BRIGH…  OUTCOME\n"
            "Lamp    Kitch…  Cotta…  40 %    ok\n"
            "Away    Kitch…  Cotta…          unreach…\n"
            "1 light read, 1 unreachable: Away\n");
}

}  // namespace
}  // namespace nidus
