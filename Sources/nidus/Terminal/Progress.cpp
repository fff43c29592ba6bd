#include "nidus/Terminal/Progress.h"

#include <unistd.h>

#include <algorithm>
#include <utility>

#include "HomePlatform/System/OneLine.h"
#include "nidus/StandardStreams.h"
#include "nidus/Terminal/Terminal.h"

namespace nidus {
namespace {

void writeToTerminal(const std::string& text) {
  // A terminal that is gone has nobody who would miss the line.
  static_cast<void>(writeWhole(STDERR_FILENO, text));
}

}  // namespace

Progress::Progress(Work work)
    : work_(std::move(work)),
      columns_(work_.total < work_.longFrom ? 0 : standardErrorStyle().columns) {}

void Progress::reach(std::size_t done) {
  constexpr std::size_t kWhole = 100;
  if (columns_ == 0) return;
  const std::size_t percent = std::min(done, work_.total) * kWhole / work_.total;
  if (shownPercent_ == percent) return;
  shownPercent_ = percent;
  const std::string line =
      shortened(onOneLine(work_.name) + ": " + std::to_string(percent) + " % of " + work_.amount,
                columns_ - 1);
  const std::size_t cells = cellsOf(line);
  const std::size_t left = shownCells_ > cells ? shownCells_ - cells : 0;
  writeToTerminal('\r' + line + std::string(left, ' '));
  shownCells_ = cells + left;
}

void Progress::wipe() {
  if (shownCells_ == 0) return;
  writeToTerminal('\r' + std::string(shownCells_, ' ') + '\r');
  shownCells_ = 0;
  shownPercent_.reset();
}

}  // namespace nidus
