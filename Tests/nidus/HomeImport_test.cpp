#include <csignal>

#include "nidus/ProgramTest.h"
#include "nidus/TerminalProcess.h"

namespace nidus {
namespace {

using ::testing::AnyOf;
using ::testing::ContainsRegex;
using ::testing::HasSubstr;
using ::testing::IsEmpty;
using ::testing::Not;

/// A document of more than a megabyte, with so many lamps that storing them takes a while.
std::string largeDocument() {
  constexpr int kLamps = 3000;
  std::string home = R"({"uuid": "AA00AA00-0000-4000-8000-000000000009", "name": "Hotel",
      "accessories": [)";
  for (int i = 0; i < kLamps; ++i) {
    const std::string number = std::to_string(10000 + i);
    home += (i == 0 ? "" : ",") + (R"({"uuid": "DD00DD00-0000-4000-8000-0000000)" + number) +
            R"(", "name": "Lamp )" + number + R"(", "services": [{"instanceID": 8, "name": "Lamp",
             "serviceType": "com.corvane.nidus.service.light", "characteristics": [
             {"instanceID": 9, "characteristicType": "com.corvane.nidus.characteristic.power",
              "properties": ["readable", "writable"], "value": true,
              "metadata": {"format": "bool"}}]}]})";
  }
  return documentOf({home + "]}"});
}

class LargeImportTest : public ProgramTest {
 protected:
  [[nodiscard]] ProgramStart importStart() const { return start({"home", "import", file_}); }
  /// Interrupts an import when it says `text`, and gives what became of it.
  [[nodiscard]] ProgramEnd interruptedAt(const std::string& text) const {
    TerminalProcess terminal(importStart());
    EXPECT_TRUE(terminal.waitFor(text)) << terminal.output();
    terminal.interrupt();
    return terminal.finish();
  }

  const std::string file_ = folder_.write("large.json", largeDocument());
};

TEST_F(LargeImportTest, ShowsItsProgressOnATerminal) {
  TerminalProcess terminal(importStart(), 200);
  EXPECT_TRUE(terminal.waitFor("\rReading: "));
  EXPECT_TRUE(terminal.waitFor("100 % of 1 MB")) << terminal.output();
  EXPECT_TRUE(terminal.waitFor("\rStoring: 0 % of 3000 accessories"));
  EXPECT_TRUE(terminal.waitFor("\rStoring: 100 % of 3000 accessories"));
  const ProgramEnd end = terminal.finish();
  EXPECT_EQ(end.exitStatus, 0);
  EXPECT_THAT(end.output, ContainsRegex("\r +\rimported 1 home, 0 rooms, 3000 accessories, "));
}

TEST_F(LargeImportTest, KeepsTheProgressOutOfThePipe) {
  ProgramStart piped = importStart();
  piped.outputFile = folder_.file("output");
  EXPECT_THAT(runOnTerminal(piped).output, HasSubstr("Storing: "));
  EXPECT_EQ(contentOfFile(piped.outputFile),
            "imported 1 home, 0 rooms, 3000 accessories, 3000 services\n");
}

TEST_F(LargeImportTest, ShowsNoProgressInAPipe) {
  const ProgramEnd end = runProgram(importStart());
  EXPECT_EQ(end.exitStatus, 0);
  EXPECT_THAT(end.errors, IsEmpty());
  EXPECT_THAT(end.output, Not(HasSubstr("%")));
}

TEST_F(LargeImportTest, ShortensTheProgressOnANarrowTerminal) {
  const std::string output = runOnTerminal(importStart(), 30).output;
  EXPECT_THAT(output, HasSubstr("\rStoring: 100 % of 3000 acc"));
  EXPECT_THAT(output, HasSubstr("…"));
}

TEST_F(LargeImportTest, StoresAllOrNothingWhenInterrupted) {
  importSmallHome();
  const std::string before = exported();
  import(contentOfFile(file_));
  const std::string after = exported();
  for (const char* text : {"Reading: ", "Storing: 0 %", "Storing: 50 %", "Storing: 100 %"}) {
    SCOPED_TRACE(text);
    importSmallHome();
    const bool isToldStored = interruptedAt(text).output.find("imported") != std::string::npos;
    const std::string now = exported();
    EXPECT_THAT(now, AnyOf(before, after));
    EXPECT_TRUE(now == after || !isToldStored);
  }
}

TEST_F(LargeImportTest, ConfiguresTheHomesThatItStored) {
  static_cast<void>(interruptedAt("Storing: 100 %"));
  const bool isStored = exported().find("Hotel") != std::string::npos;
  EXPECT_EQ(run({"records"}).output.find("Hotel") != std::string::npos, isStored);
}

TEST_F(ProgramTest, LeavesTheHomesWhenInterruptedWhileReading) {
  importSmallHome();
  const std::string before = exported();
  TerminalProcess terminal(start({"home", "import", "-"}));
  terminal.write("{\"format\": \"nidus-home/1\",\n");
  terminal.interrupt();
  EXPECT_EQ(terminal.finish().signal, SIGINT);
  EXPECT_EQ(exported(), before);
}

TEST_F(ProgramTest, ShowsNoProgressOfAShortImport) {
  const auto file = folder_.write("small.json", documentOf({smallHome()}));
  const ProgramEnd end = runOnTerminal(start({"home", "import", file}));
  EXPECT_EQ(end.output, "imported 1 home, 1 room, 3 accessories, 3 services\n");
}

}  // namespace
}  // namespace nidus
