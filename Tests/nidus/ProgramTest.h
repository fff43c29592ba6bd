#pragma once

#include <gmock/gmock.h>

#include <string>
#include <utility>
#include <vector>

#include "Support/TestFolder.h"
#include "nidus/ProgramProcess.h"

namespace nidus {

/// A home with two lamps in one kitchen, a lock that wants an unlocked device, and two scenes.
[[nodiscard]] std::string smallHome();

/// An accessory with one light that has power and brightness; `more` are further members of it,
/// each with a comma behind it.
[[nodiscard]] std::string lampDocument(const std::string& uuid, const std::string& name,
                                       const std::string& more = "");

/// A home of the given name that has nothing in it; its UUID ends in `number`, one digit.
[[nodiscard]] std::string emptyHome(const std::string& name, int number);

/// A document of these homes.
[[nodiscard]] std::string documentOf(const std::vector<std::string>& homes);

/// Commands of one line, without its end.
[[nodiscard]] std::string readCommandLine(const std::string& serviceName);
[[nodiscard]] std::string setCommandLine(const std::string& serviceName, bool isOn);

/// One line that starts with "nidus: " and `start`, and its end.
MATCHER_P(IsOneFailure, start, "") {
  const std::string& text = arg;
  const std::string whole = std::string("nidus: ") + start;
  return text.compare(0, whole.size(), whole) == 0 && text.find('\n') == text.size() - 1;
}

/// Runs the program on a data folder of its own.
class ProgramTest : public ::testing::Test {
 protected:
  [[nodiscard]] ProgramStart start(std::vector<std::string> arguments,
                                   std::string input = "") const {
    arguments.insert(arguments.begin(), {"--data", data()});
    return {std::move(arguments), std::move(input)};
  }
  [[nodiscard]] ProgramEnd run(std::vector<std::string> arguments, std::string input = "") const {
    return runProgram(start(std::move(arguments), std::move(input)));
  }
  /// Imports a document, which must work.
  void import(const std::string& document) const {
    const ProgramEnd end = run({"home", "import", folder_.write("import.json", document)});
    ASSERT_EQ(end.exitStatus, 0) << end.errors;
  }
  void importSmallHome() const { import(documentOf({smallHome()})); }
  [[nodiscard]] std::string exported() const { return run({"home", "export"}).output; }
  [[nodiscard]] std::string data() const { return folder_.file("data"); }

  const TestFolder folder_;
};

}  // namespace nidus
