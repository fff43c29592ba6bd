#pragma once

#include <memory>
#include <string>
#include <vector>

#include "Load/ProcessFigures.h"
#include "Load/Stage.h"
#include "Load/StressOptions.h"
#include "Load/StressRecord.h"

namespace nidus {

/// One run of the stress program: rounds of commands, syncs and changes, each from as many threads
/// as there are callers, with everything at rest in between. Used by one thread.
class Stress {
 public:
  /// `seed` is where all drawn numbers come from.
  Stress(const StressOptions& options, std::uint64_t seed);
  ~Stress();

  /// Runs all rounds and judges what the process takes up at the end.
  void run();
  /// What was done, line by line.
  [[nodiscard]] std::vector<std::string> report() const;
  /// What was wrong, line by line.
  [[nodiscard]] std::vector<std::string> complaints() const { return record_.complaints(); }

 private:
  struct Measured {
    std::size_t commands = 0;
    ProcessFigures figures;
  };

  void runRounds();
  void runRound();
  void call(std::size_t caller, Random random);
  [[nodiscard]] bool isOver() const;
  void plantLeaks();
  void judgeGrowth();

  const StressOptions options_;
  Random random_;
  StressRecord record_;
  std::unique_ptr<Stage> stage_;
  std::size_t roundEnd_ = 0;  ///< The number of commands with which the round is over.
  double seconds_ = 0;
  Measured first_;
  Measured last_;
};

}  // namespace nidus
