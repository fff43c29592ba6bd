#pragma once

#include <atomic>
#include <memory>
#include <vector>

#include "Load/Stage.h"
#include "Load/StressRecord.h"
#include "Load/UnrulyPlatform.h"
#include "PlatformModel/System/NDMutex.h"

namespace nidus {

class NDAssistantCommand;

/// Each round has an unruly platform of its own, which is shut down at the end: at rest, or in the
/// midst of it. Commands are given without waiting for their replies and are judged when they are
/// over, whenever that is.
class UnrulyStage final : public Stage {
 public:
  /// `record` outlives the stage.
  UnrulyStage(StressRecord& record, std::size_t callers);
  ~UnrulyStage() override;

  void beginRound(std::size_t commands, Random& random) override;
  void command(std::size_t caller, Random& random) override;
  void sync(std::size_t caller, Random& random) override;
  void change(std::size_t caller, Random& random) override;
  void runMainQueue(const std::function<bool()>& haveCallersGone) override;
  void wakeMainQueue() override;
  void endRound() override;

 private:
  void changeHomes(Random& random);

  StressRecord& record_;
  const UnrulyPlatform::Services services_;
  std::shared_ptr<UnrulyPlatform> platform_;
  bool isAbrupt_ = false;
  std::size_t abruptEnd_ = 0;  ///< The number of commands with which an abrupt round ends.
  /// For each caller a command that it has not let go of.
  std::vector<std::shared_ptr<NDAssistantCommand>> kept_;
};

}  // namespace nidus
