#include <algorithm>
#include <cstddef>
#include <iostream>
#include <iterator>
#include <memory>
#include <streambuf>
#include <string>
#include <utility>

#include "AssistantHost/CommandReader.h"
#include "AssistantHost/InputFile.h"
#include "AssistantHost/InputLines.h"
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

/// A file whose beginning has been read already.
class ResumedBuffer final : public std::streambuf {
 public:
  ResumedBuffer(std::string beginning, std::streambuf& rest)
      : block_(std::move(beginning)), rest_(rest) {
    setg(block_.data(), block_.data(), block_.data() + block_.size());
  }

 protected:
  int_type underflow() override {
    block_.resize(kBlockSize);
    const std::streamsize size = rest_.sgetn(block_.data(), std::ssize(block_));
    if (size <= 0) return traits_type::eof();
    setg(block_.data(), block_.data(), block_.data() + size);
    return traits_type::to_int_type(block_.front());
  }

 private:
  static constexpr std::size_t kBlockSize = 65536;
  std::string block_;
  std::streambuf& rest_;
};

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
    InputLines lines(in);
    const auto place = [&] { return name + ": line " + std::to_string(lines.number()); };
    while (!isCutShort_ && lines.next()) {
      if (!isBlank(lines.line())) performLine(lines.line(), place());
    }
    if (lines.isTooLong()) {
      keep(report({Failure::Kind::badInput, place() + ": " + lines.tooLongText()}));
    } else if (in.bad()) {
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
  const auto beginning = readUpTo(kBytesToJudge, *in, file);
  if (!beginning) return report(beginning.failure());
  const auto session = workspace.assistant();
  if (!session) return report(session.failure());
  Performance performance(**session);
  if (isOneDocument(*beginning)) {
    performance.perform(*beginning, file);
  } else {
    ResumedBuffer buffer(*beginning, *in->rdbuf());
    std::istream whole(&buffer);
    performance.performLines(whole, file);
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
