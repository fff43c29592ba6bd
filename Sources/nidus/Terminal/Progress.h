#pragma once

#include <cstddef>
#include <optional>
#include <string>

namespace nidus {

/// Work that may take long.
struct Work {
  std::string name;      ///< What is done, "Reading".
  std::size_t total;     ///< How much there is to do, in any unit.
  std::string amount;    ///< The same in words, "12 MB".
  std::size_t longFrom;  ///< The total from which on it is worth showing.
};

/// Shows how far a long work is, on one line of the terminal on standard error, which is wiped in
/// the end. Shows nothing when standard error is no terminal, or the work is not long.
///
///     Progress progress({"Storing", accessories, "12000 accessories", 500});
///     progress.reach(6000);  // Storing: 50 % of 12000 accessories
class Progress {
 public:
  explicit Progress(Work work);
  ~Progress() { wipe(); }
  Progress(const Progress&) = delete;
  Progress& operator=(const Progress&) = delete;

  /// Shows that so much of the total is done.
  void reach(std::size_t done);
  /// Takes the line away, so that something else can be written; `reach` shows it again.
  void wipe();

 private:
  const Work work_;
  const std::size_t columns_;  ///< 0 when nothing is shown.
  std::optional<std::size_t> shownPercent_;
  std::size_t shownCells_ = 0;
};

}  // namespace nidus
