#pragma once

#include <atomic>
#include <cstddef>
#include <map>
#include <string>
#include <string_view>
#include <vector>

#include "Load/LifeWatch.h"
#include "PlatformModel/System/NDMutex.h"

namespace nidus {

/// A fault that the program makes on purpose, to show that it would be noticed.
enum class Plant { nothing, lostReply, leakedCommand, leakedMemory, leakedDescriptor };

/// What a run has done and what was wrong with it. May be used from any thread.
class StressRecord {
 public:
  explicit StressRecord(Plant plant) : plant_(plant) {}

  std::atomic<std::size_t> commands = 0;    ///< Begun.
  std::atomic<std::size_t> ended = 0;       ///< Commands that can not answer any more.
  std::atomic<std::size_t> unanswered = 0;  ///< Ended commands that have not answered.
  std::atomic<std::size_t> replies = 0;
  std::atomic<std::size_t> syncs = 0;
  std::atomic<std::size_t> resets = 0;
  std::atomic<std::size_t> changes = 0;  ///< Of the homes.
  LifeWatch lives;

  /// Says what is wrong; `where` is an example for people.
  void complain(const std::string& fault, const std::string& where);
  /// Complains unless `holds`.
  void expect(bool holds, const std::string& fault, const std::string& where) {
    if (!holds) complain(fault, where);
  }
  /// Complains of what is alive that should not be.
  void expectNoSurvivors(const std::string& where);
  /// One line for each fault: how often, what, and where it was seen first.
  [[nodiscard]] std::vector<std::string> complaints() const;

  /// Whether the fault `plant` is to be made now; true once in a run, at its hundredth chance.
  [[nodiscard]] bool isDue(Plant plant);
  /// Whether `plant` is the fault of this run.
  [[nodiscard]] bool isPlanted(Plant plant) const { return plant_ == plant; }

 private:
  struct Complaint {
    std::size_t count = 0;
    std::string first;
  };

  const Plant plant_;
  std::atomic<std::size_t> chances_ = 0;
  mutable NDMutex mutex_;
  std::map<std::string, Complaint> complaints_ ND_GUARDED_BY(mutex_);
};

}  // namespace nidus
