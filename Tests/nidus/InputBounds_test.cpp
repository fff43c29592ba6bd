#include "HomePlatform/Json/JsonLimits.h"
#include "Support/Sanitizers.h"
#include "nidus/ProgramTest.h"

namespace nidus {
namespace {

using ::testing::HasSubstr;

constexpr std::size_t kMost = kCommandLimits.documentBytes;

/// Lines and documents that are too long for the program.
class InputBoundsTest : public ProgramTest {};

TEST_F(InputBoundsTest, EndPerformAtALineThatIsTooLong) {
  importSmallHome();
  const std::string good = readCommandLine("Lamp") + "\n";
  for (const auto& [arguments, name] :
       {std::pair(std::vector<std::string>{"perform"}, std::string("standard input")),
        std::pair(std::vector<std::string>{"perform", folder_.file("long")},
                  folder_.file("long"))}) {
    const std::string input = good + std::string(kMost + 1, ' ') + "\n" + good;
    folder_.write("long", input);
    const ProgramEnd end = run(arguments, input);
    EXPECT_EQ(end.exitStatus, 2);
    EXPECT_THAT(end.output, HasSubstr("COMMAND_SUCCESS"));
    EXPECT_EQ(end.output.find('\n'), end.output.size() - 1) << "one reply";
    EXPECT_THAT(end.errors, IsOneFailure(name + ": line 2: the line is longer than 4000000 bytes; "
                                                "it and what follows are not read"));
  }
}

TEST_F(InputBoundsTest, EndTheShellAtALineThatIsTooLong) {
  const ProgramEnd end =
      run({"shell"}, "vocabulary power\n" + std::string(kMost + 1, 'a') + "\nvocabulary power\n");
  EXPECT_EQ(end.exitStatus, 2);
  EXPECT_THAT(end.errors, IsOneFailure("line 2: the line is longer than 4000000 bytes; "
                                       "it and what follows are not read"));
}

TEST_F(InputBoundsTest, SayWhenMemoryIsShort) {
  if (kIsSanitized) GTEST_SKIP() << "the sanitizers need memory of their own";
  const auto room = [](const std::string& number) {
    return R"({"uuid": "BB00BB00-0000-4000-8000-00000000000)" + number + R"(", "name": ")" +
           std::string(900'000, 'a') + "\"}";
  };
  const std::string home = R"({"uuid": "AA00AA00-0000-4000-8000-000000000001", "name": "Cottage",
      "rooms": [)" + room("1") +
                           "," + room("2") + "]}";
  ProgramStart limited;
  limited.program = "/bin/sh";
  // Enough for the program, in kilobytes, but not for the home.
  limited.arguments = {"-c", "ulimit -d 2500; exec " NIDUS_PROGRAM " home check \"$1\"", "sh",
                       folder_.write("large.json", documentOf({home}))};
  const ProgramEnd end = runProgram(limited);
  EXPECT_EQ(end.exitStatus, 4);
  EXPECT_THAT(end.errors, IsOneFailure("there is not enough memory for this; "));
}

}  // namespace
}  // namespace nidus
