#pragma once

#include <functional>
#include <memory>

#include "Load/Ledger.h"
#include "PlatformModel/Home/NDHomeManager.h"
#include "PlatformModel/System/NDMutex.h"

namespace nidus {

/// A home manager whose homes may change while they are being looked at. May be used from any
/// thread.
class UnrulyManager final : public NDHomeManager,
                            public std::enable_shared_from_this<UnrulyManager> {
 public:
  /// What the manager shows: `homes`, and from the look after `looks` looks on, whatever `later`
  /// gives then. An empty `later` leaves them.
  struct Show {
    NDArray<NDHome> homes = {};
    std::size_t looks = 0;
    std::function<NDArray<NDHome>()> later = {};
  };
  /// `ledger` may be null.
  UnrulyManager(std::shared_ptr<Ledger> ledger, Show show);

  [[nodiscard]] NDArray<NDHome> homes() const override;
  void setDelegate(std::weak_ptr<NDHomeManagerDelegate> delegate) override;

  /// Tells the delegate, if it is still there, of the homes, or that they never come.
  void report();
  void reportNever();

 private:
  [[nodiscard]] std::shared_ptr<NDHomeManagerDelegate> delegate() const;

  const std::shared_ptr<Ledger> ledger_;
  mutable NDMutex mutex_;
  mutable Show show_ ND_GUARDED_BY(mutex_);
  mutable bool isFirstLook_ ND_GUARDED_BY(mutex_) = true;
  std::weak_ptr<NDHomeManagerDelegate> delegate_ ND_GUARDED_BY(mutex_);
};

}  // namespace nidus
