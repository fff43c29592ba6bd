#pragma once

#include <benchmark/benchmark.h>

namespace nidus {

/// Prints one line for each row, as it is measured: what it is, the size of the home, ours, the
/// floor, their ratio, the goal, and whether it is met; and below the rows of one kind how ours
/// grows with the home.
class ResultTable final : public benchmark::BenchmarkReporter {
 public:
  bool ReportContext(const Context& context) override;
  void ReportRuns(const std::vector<Run>& runs) override;
  void Finalize() override;

 private:
  void printRow(const Run& run);
  void printGrowth(const Run& run);

  int rows_ = 0;
  int goals_ = 0;
  int met_ = 0;
};

}  // namespace nidus
