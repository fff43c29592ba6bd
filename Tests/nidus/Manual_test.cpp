#include <fstream>
#include <iterator>
#include <sstream>

#include "HomePlatform/Json/JsonLimits.h"
#include "nidus/CommandLine.h"
#include "nidus/Completion/CommandOutline.h"
#include "nidus/ProgramTest.h"
#include "nidus/Workspace.h"

namespace nidus {
namespace {

using ::testing::HasSubstr;
using ::testing::IsEmpty;

constexpr const char kManual[] = NIDUS_DOCUMENTATION "/nidus.1";

/// Compares the manual page with what the program declares.
class ManualTest : public ::testing::Test {
 protected:
  ManualTest() {
    std::ifstream in(kManual);
    page_.assign(std::istreambuf_iterator<char>(in), {});
    declareProgram(program_, workspace_);
  }

  /// The part about a command: under its own heading, or, for one of several kinds, under that of
  /// the command above it.
  [[nodiscard]] std::string partAbout(const CommandOutline& command) const {
    const std::string heading = "\n.SS " + pathOf(command);
    for (const char* end : {" ", "\n"}) {
      const std::size_t start = page_.find(heading + end);
      if (start == std::string::npos) continue;
      return page_.substr(start, page_.find("\n.S", start + 1) - start);
    }
    return command.above() ? partAbout(*command.above()) : "";
  }
  static std::string pathOf(const CommandOutline& command) {
    return (command.above() ? pathOf(*command.above()) + ' ' : "") + command.name();
  }
  /// A name of an option as the page writes it.
  static std::string written(const std::string& option) {
    std::string text;
    for (const char c : option) text += c == '-' ? std::string("\\-") : std::string(1, c);
    return text;
  }

  void expectCommands(const CommandOutline& above) const {
    for (const auto& command : above.commands()) {
      if (command->isHidden()) continue;
      SCOPED_TRACE(pathOf(*command));
      expectCommands(*command);
      if (command->commands().empty()) expectCommand(*command);
    }
  }

  std::string page_;
  Workspace workspace_;
  CommandOutline program_;

 private:
  void expectCommand(const CommandOutline& command) const {
    std::string part = partAbout(command);
    EXPECT_THAT(part, HasSubstr(command.name()));
    if (command.findOption("--entity")) part += ordersPart();
    for (const auto& option : command.options()) {
      for (const std::string& name : option.names) EXPECT_THAT(part, HasSubstr(written(name)));
    }
  }
  [[nodiscard]] std::string ordersPart() const {
    const std::size_t start = page_.find("\n.SH ORDERS");
    return page_.substr(start, page_.find("\n.SS", start) - start);
  }
};

TEST_F(ManualTest, HasEachCommandWithItsOptions) { expectCommands(program_); }

TEST_F(ManualTest, HasTheOptionsOfAllCommands) {
  for (const auto& option : program_.options()) {
    for (const std::string& name : option.names) EXPECT_THAT(page_, HasSubstr(written(name)));
  }
}

TEST_F(ManualTest, HasNoCommandThatThereIsNot) {
  for (std::size_t at = page_.find("\n.SS nidus "); at != std::string::npos;
       at = page_.find("\n.SS nidus ", at + 1)) {
    std::istringstream words(page_.substr(at + 11, page_.find('\n', at + 1) - at - 11));
    std::string word;
    words >> word;
    const CommandOutline* command = program_.findCommand(word);
    ASSERT_TRUE(command) << word;
    if (word != "home") continue;
    words >> word;
    EXPECT_TRUE(command->findCommand(word)) << word;
  }
}

/// A number as the page writes it: 4,000,000.
std::string grouped(std::size_t number) {
  std::string text = std::to_string(number);
  for (std::size_t digits = 3; digits < text.size(); digits += 4) {
    text.insert(text.size() - digits, ",");
  }
  return text;
}

TEST_F(ManualTest, TellsTheLimitsThatAreKept) {
  const std::size_t start = page_.find("\n.SH LIMITS");
  const std::string part = page_.substr(start, page_.find("\n.SH", start + 1) - start);
  const JsonLimits usual;
  EXPECT_THAT(part, HasSubstr("scenario has at most " + grouped(usual.documentBytes) + " bytes"));
  EXPECT_EQ(kHomeDocumentLimits.documentBytes, usual.documentBytes);
  EXPECT_EQ(kScenarioLimits.documentBytes, usual.documentBytes);
  EXPECT_THAT(part, HasSubstr("vocabulary " + grouped(kVocabularyLimits.documentBytes) + ','));
  EXPECT_THAT(part, HasSubstr("command\n" + grouped(kCommandLimits.documentBytes) + ','));
  EXPECT_THAT(part, HasSubstr("preferences " + grouped(kPreferencesLimits.documentBytes) + '.'));
  EXPECT_THAT(part, HasSubstr("A text has at most " + grouped(usual.textBytes) + " bytes"));
  EXPECT_THAT(part, HasSubstr("a key " + grouped(usual.keyBytes) + ','));
  EXPECT_THAT(part, HasSubstr("a number " + grouped(usual.numberBytes) + ','));
  EXPECT_THAT(part, HasSubstr("of them " + grouped(usual.spaceBytes) + '.'));
  EXPECT_THAT(part, HasSubstr("array has at most " + grouped(usual.arrayElements) + " elements"));
  EXPECT_THAT(part, HasSubstr("alone " + grouped(kCommandLimits.arrayElements) + '.'));
  EXPECT_THAT(part, HasSubstr("most " + grouped(usual.objectKeys) + " keys"));
  EXPECT_THAT(part, HasSubstr("at most " + grouped(usual.depth) + " deep"));
}

TEST_F(ManualTest, TellsHowManyValuesThereMayBe) {
  for (const auto& [before, limits] :
       {std::pair("command has at most ", kCommandLimits),
        std::pair("a vocabulary ", kVocabularyLimits),
        std::pair("the preferences ", kPreferencesLimits), std::pair("scenario ", kScenarioLimits),
        std::pair("document has at most ", kHomeDocumentLimits)}) {
    EXPECT_THAT(page_, HasSubstr(before + grouped(limits.valuesInMemory)));
  }
}

TEST_F(ManualTest, IsWellFormed) {
  const ProgramEnd end = runProgram(
      {.arguments = {"-T", "lint", "-W", "warning", kManual}, .program = "/usr/bin/mandoc"});
  EXPECT_EQ(end.exitStatus, 0);
  EXPECT_THAT(end.output + end.errors, IsEmpty());
}

}  // namespace
}  // namespace nidus
