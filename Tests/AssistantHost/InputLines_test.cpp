#include "AssistantHost/InputLines.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <sstream>
#include <string>
#include <vector>

namespace nidus {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

std::vector<std::string> linesOf(InputLines& input) {
  std::vector<std::string> lines;
  while (input.next()) lines.push_back(input.line());
  return lines;
}

TEST(InputLinesTest, GiveWhatStandsBetweenLineEnds) {
  std::istringstream in("one\n\n three \nlast");
  InputLines input(in);
  EXPECT_THAT(linesOf(input), ElementsAre("one", "", " three ", "last"));
  EXPECT_EQ(input.number(), 4U);
  EXPECT_FALSE(input.isTooLong());
}

TEST(InputLinesTest, EndWithTheLastLineEnd) {
  std::istringstream none("");
  InputLines nothing(none);
  EXPECT_THAT(linesOf(nothing), IsEmpty());
  std::istringstream ended("one\n");
  InputLines one(ended);
  EXPECT_THAT(linesOf(one), ElementsAre("one"));
}

TEST(InputLinesTest, ReadLinesOfAnyLength) {
  for (const std::size_t length : {4094U, 4095U, 4096U, 8190U, 8191U, 100000U}) {
    SCOPED_TRACE(length);
    const std::string line(length, 'a');
    for (const char* end : {"", "\n"}) {
      std::istringstream in(line + "\n" + line + end);
      InputLines input(in);
      EXPECT_THAT(linesOf(input), ElementsAre(line, line));
    }
  }
}

TEST(InputLinesTest, EndAtALineThatIsTooLong) {
  for (const char* text : {"1\n12345\n123456\n1", "1\n12345\n123456", "1\n12345\n123456789"}) {
    SCOPED_TRACE(text);
    std::istringstream in(text);
    InputLines input(in, 5);
    EXPECT_THAT(linesOf(input), ElementsAre("1", "12345"));
    EXPECT_TRUE(input.isTooLong());
    EXPECT_EQ(input.number(), 3U);
    EXPECT_FALSE(input.next());
    EXPECT_EQ(input.tooLongText(),
              "the line is longer than 5 bytes; it and what follows are not read");
  }
}

TEST(InputLinesTest, ReadNoMoreThanIsNeededToRefuse) {
  std::istringstream in(std::string(100000, 'a'));
  InputLines input(in, 10000);
  EXPECT_FALSE(input.next());
  EXPECT_LT(in.tellg(), 20000);
}

}  // namespace
}  // namespace nidus
