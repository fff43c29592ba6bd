#include <cstddef>
#include <sstream>
#include <string>
#include <utility>

#include "AssistantHost/SyncClient.h"
#include "HomePlatform/Store/HomeDocument.h"
#include "nidus/CommandLine.h"
#include "nidus/CommandSyntax.h"
#include "nidus/Commands/Commands.h"
#include "nidus/Commands/DemoSteps.h"
#include "nidus/Commands/HomeInput.h"
#include "nidus/InterruptionHold.h"
#include "nidus/Shell/Shell.h"
#include "nidus/StandardStreams.h"
#include "nidus/TemporaryFolder.h"
#include "nidus/Workspace.h"

namespace nidus {

/// The text of Resources/demonstration-home.json.
extern const std::string_view kDemonstrationHome;

namespace {

constexpr const char kEnd[] =
    "\nWhat to try next: begin with a home of your own to play with, and talk to it.\n"
    "  nidus demo --home > home.json          the home of this tour, as a document\n"
    "  nidus home import home.json\n"
    "  nidus shell                            the same orders, line by line\n"
    "  nidus vocabulary                       the words of orders\n"
    "  nidus explain set brightness 40%       what an order would do\n"
    "  nidus doctor                           what is wrong with the home\n"
    "  nidus --help                           everything else\n";

std::string heading(std::string_view title) { return "\n# " + std::string(title) + '\n'; }

/// Leads through what the plug-in can do, on a home of its own.
class Tour {
 public:
  explicit Tour(Workspace& workspace)
      : workspace_(workspace), shell_(workspace, [&workspace](CommandSyntax& program) {
          declareWorkspaceCommands(program, workspace);
        }) {}

  /// Imports the home and shows one thing after the other.
  Status run() {
    if (auto failure = importHome()) return failure;
    if (auto failure = synchronise()) return failure;
    for (const DemoStep& step : demoSteps()) {
      if (auto failure = show(step)) return failure;
    }
    return writeOutput(kEnd);
  }

  /// How many answers were not the expected ones.
  [[nodiscard]] std::size_t differences() const { return differences_; }

 private:
  Status importHome() {
    std::istringstream document{std::string(kDemonstrationHome)};
    const auto homes = readHomeDocument(document, "demonstration home");
    if (!homes) return homes.failure();
    const auto session = workspace_.home();
    if (!session) return session.failure();
    if (auto failure = (*session)->platform().importHomes(*homes, false)) return failure;
    return writeOutput("A tour on the demonstration home: " + sizeOf(*homes) + "\n");
  }

  /// The names, a line for each kind instead of one for each name.
  Status synchronise() {
    const auto session = workspace_.assistant();
    if (!session) return session.failure();
    const auto made = SyncClient::make((*session)->module());
    if (!made) return made.failure();
    SyncClient& sync = **made;
    sync.begin(kSyncKey);
    const auto changes = sync.allChanges();
    sync.end();
    const std::size_t names = changes.size() - 1;
    if (sync.resets().size() != 1 || names == 0) tellDifference("sync");
    std::string text =
        heading("A sync: the assistant learns the names (nidus sync prints them all)") +
        std::to_string(names) + " names:";
    constexpr std::size_t kShown = 5;
    for (std::size_t i = 0; i < names && i < kShown; ++i) {
      text += ' ' + changes[i * names / kShown].object->name().str() + ',';
    }
    text += " …";
    return writeOutput(text + '\n');
  }

  Status show(const DemoStep& step) {
    if (auto failure =
            writeOutput(heading(step.title) + "$ nidus " + std::string(step.line) + '\n'))
      return failure;
    const ExitStatus status = shell_.runLine(step.line);
    if (status == ExitStatus::platformFailed) {
      return Failure{Failure::Kind::platform, "demo: the tour ends here"};
    }
    if (status != step.expected) tellDifference(step.line);
    return std::nullopt;
  }

  void tellDifference(std::string_view line) {
    ++differences_;
    reportLine("demo: this answer is not the expected one: nidus " + std::string(line));
  }

  Workspace& workspace_;
  Shell shell_;
  std::size_t differences_ = 0;
};

ExitStatus lead() {
  const InterruptionHold hold;  // the folder is removed first
  const auto folder = TemporaryFolder::make();
  if (!folder) return report(folder.failure());
  HomePlatformOptions options;
  options.dataFolder = folder->path();
  // The tour shows temperatures in Celsius, wherever it runs.
  options.metric = true;
  // Two replies to one command come in one order.
  options.drainsOnCaller = true;
  Workspace workspace(std::move(options));
  Tour tour(workspace);
  if (auto failure = tour.run()) return report(*failure);
  return tour.differences() == 0 ? ExitStatus::success : ExitStatus::otherOutcome;
}

}  // namespace

void declareDemo(CommandSyntax& program) {
  const auto printsHome = std::make_shared<bool>(false);
  CommandSyntax& syntax = program.command(
      "demo", "Shows what the plug-in can do, on a home of its own",
      "Works in a temporary folder; your own homes are neither read nor changed.\n\n"
      "Example:\n  nidus demo\n\n"
      "Exit status: 0 success, 1 an answer is not the expected one, 2 bad input, 4 the platform\n"
      "failed.");
  syntax.flag("--home", *printsHome, "Print the document of the demonstration home instead");
  syntax.run([printsHome] { return *printsHome ? printText(kDemonstrationHome) : lead(); });
}

}  // namespace nidus
