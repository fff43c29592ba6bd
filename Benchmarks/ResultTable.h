#pragma once

#include <benchmark/benchmark.h>

#include <vector>

namespace nidus {

/// Prints one line for each row, as it is measured: what it is, the size of the home, ours, the
/// floor, their ratio, the goal, and whether it is met; and below the rows of one kind what power
/// of the size ours grows as, told from the ratios, since the floor's is known. The bare times
/// would not tell: where the caches end, even a pass over an array grows much faster than the
/// array.
class ResultTable final : public benchmark::BenchmarkReporter {
 public:
  bool ReportContext(const Context& context) override;
  void ReportRuns(const std::vector<Run>& runs) override;
  void Finalize() override;

 private:
  void printRow(const Run& run);
  /// Prints how well ours is a multiple of the floor's times, or how far off that is.
  static void printFit(const Run& run);
  /// Whether the rows of this kind have floors to grow beside.
  [[nodiscard]] bool areBesideFloor() const;
  /// Ends the rows of one kind.
  void printGrowth();
  /// Counts a goal, and gives the word that the table has for it.
  [[nodiscard]] const char* count(bool isMet);

  std::vector<Run> rowsOfKind_;
  int rows_ = 0;
  int goals_ = 0;
  int met_ = 0;
};

}  // namespace nidus
