#include <cstddef>
#include <sstream>

#include "AssistantHost/CommandReader.h"
#include "AssistantHost/JsonLine.h"
#include "AssistantHost/SyncClient.h"
#include "HomePlatform/Store/HomeDocument.h"
#include "nidus/CommandSyntax.h"
#include "nidus/Commands/Commands.h"
#include "nidus/Commands/DemoSteps.h"
#include "nidus/Commands/HomeInput.h"
#include "nidus/InterruptionHold.h"
#include "nidus/Session.h"
#include "nidus/StandardStreams.h"
#include "nidus/TemporaryFolder.h"

namespace nidus {

/// The text of Resources/demonstration-home.json.
extern const std::string_view kDemonstrationHome;

namespace {

/// Shows what the plug-in can do and compares it with what it should do.
class Demonstration {
 public:
  explicit Demonstration(Session& session) : session_(session) {}

  /// Imports the demonstration home, synchronises and performs all commands.
  Status run() {
    if (auto failure = importHome()) return failure;
    if (auto failure = synchronise()) return failure;
    for (const DemoStep& step : demoSteps()) {
      if (auto failure = perform(step)) return failure;
    }
    return std::nullopt;
  }

  /// How many answers were not the expected ones.
  [[nodiscard]] std::size_t differences() const { return differences_; }

 private:
  Status importHome() {
    std::istringstream document{std::string(kDemonstrationHome)};
    const auto homes = readHomeDocument(document, "demonstration home");
    if (!homes) return homes.failure();
    if (auto failure = session_.platform().importHomes(*homes, false)) return failure;
    return writeOutput("The demonstration home: " + sizeOf(*homes) + "\n");
  }

  Status synchronise() {
    const auto made = SyncClient::make(session_.module());
    if (!made) return made.failure();
    SyncClient& sync = **made;
    sync.begin(kSyncKey);
    const auto changes = sync.allChanges();
    sync.end();
    const std::size_t names = changes.size() - 1;
    const auto resets = sync.resets();
    if (resets.size() != 1 || names == 0 || changes.back().postAnchor != resets.front()) {
      tellDifference("one reset and an entity for each name");
    }
    std::string text = heading("A sync tells the assistant " + std::to_string(names) +
                               " names; the first of them");
    for (std::size_t i = 0; i < names && i < 3; ++i) {
      text += jsonLine(changes[i].object->dictionary());
    }
    return writeOutput(text);
  }

  Status perform(const DemoStep& step) {
    const auto command = readCommand(step.command, "demonstration");
    if (!command) return command.failure();
    session_.platform().setLocked(step.isLocked);
    const auto replies = session_.runner().perform(**command);
    if (!replies) return replies.failure();
    std::string text = heading(std::string(step.title)).append(step.command).append(1, '\n');
    for (const NDDictionary& reply : *replies) text += jsonLine(reply);
    if (auto failure = writeOutput(text)) return failure;
    if (summaryOf(*replies) != step.expected) tellDifference(step.expected);
    return std::nullopt;
  }

  static std::string heading(const std::string& title) { return "\n# " + title + '\n'; }

  void tellDifference(std::string_view expected) {
    ++differences_;
    reportLine("demo: this differs from what was expected: " + std::string(expected));
  }

  Session& session_;
  std::size_t differences_ = 0;
};

ExitStatus demonstrate() {
  const InterruptionHold hold;  // the folder is removed first
  const auto folder = TemporaryFolder::make();
  if (!folder) return report(folder.failure());
  HomePlatformOptions options;
  options.dataFolder = folder->path();
  // The expected temperatures are in Celsius, wherever this runs.
  options.metric = true;
  // Two replies to one command come in one order.
  options.drainsOnCaller = true;
  const auto session = Session::open(std::move(options));
  if (!session) return report(session.failure());
  if (auto failure = (*session)->openModule()) return report(*failure);
  Demonstration demonstration(**session);
  if (auto failure = demonstration.run()) return report(*failure);
  return (*session)->statusAfter(demonstration.differences() == 0 ? ExitStatus::success
                                                                  : ExitStatus::otherOutcome);
}

}  // namespace

void declareDemo(CommandSyntax& program) {
  CommandSyntax& syntax =
      program.command("demo", "Shows what the plug-in can do, on a home of its own",
                      "Works in a temporary folder; your own homes are neither read nor changed.\n"
                      "Exit status 1 when an answer is not the expected one.");
  syntax.run(demonstrate);
}

}  // namespace nidus
