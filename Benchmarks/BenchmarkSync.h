#pragma once

#include <cstddef>
#include <memory>

#include "Assistant/NDAssistantSyncHome.h"
#include "BenchmarkPlatform.h"

namespace nidus {

/// One handler of syncs.
///
///     sync.begin(platform);
///     benchmark::DoNotOptimize(sync.pullAll());
///     sync.end();
class BenchmarkSync {
 public:
  /// Begins a sync on `platform`, which is registered.
  void begin(const BenchmarkPlatform& platform) const;
  /// Pulls to the end and gives the number of entities.
  [[nodiscard]] std::size_t pullAll() const;
  /// Pulls the one entity after `anchor`.
  [[nodiscard]] std::shared_ptr<const VAHAEntity> pullAfter(const NDString& anchor) const;
  void end() const { handler_->syncDidEnd(); }

 private:
  const std::shared_ptr<NDAssistantSyncHome> handler_ = NDAssistantSyncHome::init();
};

}  // namespace nidus
