#pragma once

#include <atomic>
#include <memory>
#include <vector>

#include "HomePlatform/HomePlatform.h"
#include "HomePlatform/Store/HomeStore.h"
#include "Load/OwnRoom.h"
#include "Load/Stage.h"
#include "Load/StressRecord.h"
#include "Support/TestFolder.h"

namespace nidus {

/// The embedded platform on a database on disk, which it, a second platform and a second store
/// change meanwhile. One platform serves all rounds. Each caller waits for the end of its command.
///
/// In home 0, which stays as it is, each caller has a room whose replies are known beforehand; the
/// other homes change and are commanded by all.
class EmbeddedStage final : public Stage {
 public:
  /// `record` outlives the stage.
  EmbeddedStage(StressRecord& record, std::size_t callers);
  ~EmbeddedStage() override;

  void beginRound(std::size_t commands, Random& random) override;
  void command(std::size_t caller, Random& random) override;
  void sync(std::size_t caller, Random& random) override;
  void change(std::size_t caller, Random& random) override;
  void runMainQueue(const std::function<bool()>& haveCallersGone) override;
  void wakeMainQueue() override;
  void endRound() override;

 private:
  [[nodiscard]] std::shared_ptr<HomePlatform> open();
  [[nodiscard]] Replies performToEnd(const LoadCommand& command);
  void expectDone(const Status& status, const std::string& what);
  void importAll(HomePlatform& platform, Random& random);
  void writeValues(Random& random);
  void leavePending();
  void compareLevels();

  StressRecord& record_;
  const std::size_t callers_;
  const TestFolder folder_;
  std::shared_ptr<HomePlatform> platform_;
  std::shared_ptr<HomePlatform> other_;  ///< Stands for another process.
  std::unique_ptr<HomeStore> store_;
  std::vector<OwnRoom> ownRooms_;
  std::atomic<std::size_t> importsBegun_ = 0;
  std::atomic<std::size_t> importsEnded_ = 0;
};

}  // namespace nidus
