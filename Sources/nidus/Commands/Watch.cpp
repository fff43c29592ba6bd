#include <ctime>
#include <memory>
#include <optional>
#include <utility>

#include "nidus/CommandSyntax.h"
#include "nidus/Commands/Commands.h"
#include "nidus/StandardStreams.h"
#include "nidus/Watch/ChangeText.h"
#include "nidus/Watch/HomeChange.h"
#include "nidus/Watch/WatchFilter.h"
#include "nidus/Watch/WorkLoop.h"
#include "nidus/Workspace.h"

namespace nidus {
namespace {

struct WatchOptions {
  WatchFilter filter;
  bool isJson = false;
};

using Homes = std::vector<HomeData>;

/// Prints what has changed, each time that the homes are told. Used by the main thread.
class ChangePrinter {
 public:
  ChangePrinter(WatchOptions options, std::shared_ptr<const MetadataMapper> metadata)
      : options_(std::move(options)), metadata_(std::move(metadata)) {}

  void take(const Result<Homes>& homes) {
    if (end_) return;
    if (!homes) {
      end_ = report(homes.failure());
      return;
    }
    if (known_) {
      print(*homes);
    } else {
      begin(*homes);
    }
    known_ = *homes;
  }

  /// How the watch has ended by itself; none while it has not.
  [[nodiscard]] const std::optional<ExitStatus>& end() const { return end_; }

 private:
  void begin(const Homes& homes) {
    if (const Status failure = checkFilter(homes, options_.filter)) {
      end_ = report(*failure);
    } else {
      reportLine("watching " + extentOf(homes, options_.filter) + "; stop with Ctrl-C");
    }
  }

  void print(const Homes& homes) {
    const std::time_t now = std::time(nullptr);
    std::string text;
    for (const HomeChange& change : changesBetween(*known_, homes, *metadata_)) {
      if (!isWatched(change, options_.filter)) continue;
      text += options_.isJson ? changeJson(change, now)
                              : changeText(change, now, metadata_->vocabulary(), style_);
    }
    const Status failure = writeOutput(text);
    if (failure) end_ = hasReader() ? report(*failure) : ExitStatus::success;
  }

  const WatchOptions options_;
  const std::shared_ptr<const MetadataMapper> metadata_;
  const TerminalStyle style_ = standardOutputStyle();
  std::optional<Homes> known_;
  std::optional<ExitStatus> end_;
};

ExitStatus watchHomes(const WatchOptions& options, Workspace& workspace) {
  const auto session = workspace.home();
  if (!session) return report(session.failure());
  HomePlatform& platform = (*session)->platform();
  const auto queue = platform.mainQueue();
  const auto printer = std::make_shared<ChangePrinter>(
      options, std::make_shared<const MetadataMapper>(platform.vocabulary()));
  const auto watch = platform.watchHomes(
      [queue, weakPrinter = std::weak_ptr<ChangePrinter>(printer)](Result<Homes> homes) {
        queue->async([weakPrinter, homes = std::move(homes)] {
          if (const auto living = weakPrinter.lock()) living->take(homes);
        });
      });
  if (!watch) return report(watch.failure());
  if (auto failure =
          runUntilInterrupted(*queue, [&printer] { return printer->end().has_value(); })) {
    return report(*failure);
  }
  return (*session)->statusAfter(printer->end().value_or(ExitStatus::success));
}

}  // namespace

void declareWatch(CommandSyntax& program, Workspace& workspace) {
  const auto options = std::make_shared<WatchOptions>();
  CommandSyntax& syntax = program.command(
      "watch", "Prints values as they change, until it is interrupted",
      "Tells what this or any other program changes: values, accessories that come, go, move or\n"
      "cannot be reached, and names. Changes that follow each other closely may be told as one. "
      "Example:\n"
      "  nidus watch --room Kitchen\n\n"
      "Exit status: 0 interrupted or nobody reads any more, 2 bad input, 4 the platform failed.");
  syntax.option("--home", "NAME", options->filter.home, "Only what is in the home of that name");
  syntax.option("--room", "NAME", options->filter.room, "Only what is in a room of that name");
  syntax.option("--service", "NAME", options->filter.service, "Only services of that name");
  syntax.flag("--json", options->isJson, "Print one JSON object a line");
  syntax.run([options, &workspace] { return watchHomes(*options, workspace); });
}

}  // namespace nidus
