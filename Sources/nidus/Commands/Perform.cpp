#include <algorithm>
#include <cstddef>
#include <iostream>
#include <memory>
#include <sstream>

#include "AssistantHost/CommandReader.h"
#include "AssistantHost/InputFile.h"
#include "AssistantHost/JsonLine.h"
#include "nidus/CommandSyntax.h"
#include "nidus/Commands/CommandText.h"
#include "nidus/Commands/Commands.h"
#include "nidus/Outcome.h"
#include "nidus/StandardStreams.h"
#include "nidus/Workspace.h"

namespace nidus {
namespace {

constexpr const char kStandardInput[] = "standard input";

/// A place in a text of one line comes behind the number of that line: "line 3, column 7".
Failure inOnePlace(Failure failure, const std::string& name) {
  constexpr std::string_view kOwnLine = ": line 1, column ";
  if (failure.message.compare(name.size(), kOwnLine.size(), kOwnLine) == 0) {
    failure.message.replace(name.size(), kOwnLine.size(), ", column ");
  }
  return failure;
}

/// Performs commands one after the other and keeps the worst of their statuses.
class Performance {
 public:
  explicit Performance(Session& session) : session_(session) {}

  /// Reads and performs the command in `text`, and prints its replies; `name` stands for the text
  /// in messages.
  void perform(std::string_view text, const std::string& name) {
    const auto command = readCommand(text, name);
    keep(command ? performOne(**command, name) : report(command.failure()));
  }

  /// Performs the command of each line of `in` that is not blank, before the next line is read.
  void performLines(std::istream& in, const std::string& name) {
    std::string line;
    for (std::size_t number = 1; !isCutShort_ && std::getline(in, line); ++number) {
      if (!isBlank(line)) performLine(line, name + ": line " + std::to_string(number));
    }
    if (in.bad()) {
      status_ = report({Failure::Kind::platform, name + ": reading failed; try again"});
    } else if (!status_) {
      status_ =
          report({Failure::Kind::badInput, name + ": there is no command; give at least one"});
    }
  }

  /// Once something was performed.
  [[nodiscard]] ExitStatus status() const { return status_.value_or(ExitStatus::success); }

 private:
  void performLine(std::string_view text, const std::string& name) {
    const auto command = readCommand(text, name);
    keep(command ? performOne(**command, name) : report(inOnePlace(command.failure(), name)));
  }

  /// The highest status counts.
  void keep(ExitStatus status) {
    status_ = std::max(status_.value_or(ExitStatus::success), status);
  }

  ExitStatus performOne(const VAHACommand& command, const std::string& name) {
    const auto replies = session_.runner().perform(command);
    if (!replies) return cutShort(replies.failure());
    if (replies->empty()) {
      reportLine(name + ": the plug-in gave no reply; see what is there with nidus records");
    }
    for (const NDDictionary& reply : *replies) {
      if (auto failure = writeOutput(jsonLine(reply))) return cutShort(*failure);
    }
    return session_.statusAfter(statusOf(*replies));
  }

  /// Ends with a failure that the following commands would meet too.
  ExitStatus cutShort(const Failure& failure) {
    isCutShort_ = true;
    return report(failure);
  }

  Session& session_;
  bool isCutShort_ = false;
  std::optional<ExitStatus> status_;
};

ExitStatus performInput(Workspace& workspace) {
  const auto session = workspace.assistant();
  if (!session) return report(session.failure());
  Performance performance(**session);
  performance.performLines(std::cin, kStandardInput);
  return performance.status();
}

ExitStatus performFile(const std::string& file, Workspace& workspace) {
  auto in = openInput(file);
  if (!in) return report(in.failure());
  const auto text = readAll(*in, file);
  if (!text) return report(text.failure());
  const auto session = workspace.assistant();
  if (!session) return report(session.failure());
  Performance performance(**session);
  if (isOneDocument(*text)) {
    performance.perform(*text, file);
  } else {
    std::istringstream lines(*text);
    performance.performLines(lines, file);
  }
  return performance.status();
}

}  // namespace

void declarePerform(CommandSyntax& program, Workspace& workspace) {
  const auto file = std::make_shared<std::string>("-");
  CommandSyntax& syntax = program.command(
      "perform", "Performs commands and prints the replies",
      "Commands are JSON, one a line; a file may also be one command over several lines. Each "
      "reply\n"
      "is one line. Lines of standard input are answered before the next one is read.\n\n"
      "Example: which lights of the kitchen are on?\n"
      "  {\"filter\": {\"search\": {\"roomName\": \"Kitchen\", \"serviceType\": \"LIGHT\"}},\n"
      "   \"actions\": [{\"actionType\": \"GET\",\n    \"attribute\": \"POWER\", \"value\": "
      "{\"boolean\": true}}]}\n\n"
      "Exit status: 0 success, 1 any other outcome, 2 bad input, 3 no reply, 4 the platform\n"
      "failed; the highest of all commands.");
  syntax.argument("FILE", *file, "The commands; standard input when it is left out or -");
  syntax.candidates("FILE", {{CandidateKind::files}});
  syntax.run([file, &workspace] {
    return *file == "-" ? performInput(workspace) : performFile(*file, workspace);
  });
}

}  // namespace nidus
