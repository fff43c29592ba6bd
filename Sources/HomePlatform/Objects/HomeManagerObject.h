#pragma once

#include <memory>

#include "HomePlatform/Objects/PendingManagers.h"
#include "PlatformModel/Home/NDHomeManager.h"
#include "PlatformModel/System/NDMutex.h"

namespace nidus {

/// A home manager: reports once, either its homes or that they never come.
class HomeManagerObject final : public NDHomeManager,
                                public std::enable_shared_from_this<HomeManagerObject> {
 public:
  /// `pending` is where the manager is listed while it waits; never null.
  explicit HomeManagerObject(std::shared_ptr<PendingManagers> pending);
  ~HomeManagerObject() override;

  [[nodiscard]] NDArray<NDHome> homes() const override;
  void setDelegate(std::weak_ptr<NDHomeManagerDelegate> delegate) override;

  /// Takes the homes and tells the delegate, on the calling thread. Only the first of all calls of
  /// this and of `reportNever` has an effect.
  void report(NDArray<NDHome> homes);
  /// Tells the delegate that the homes never come.
  void reportNever();

 private:
  [[nodiscard]] std::shared_ptr<NDHomeManagerDelegate> beginReport(NDArray<NDHome> homes);

  const std::shared_ptr<PendingManagers> pending_;
  mutable NDMutex mutex_;
  NDArray<NDHome> homes_ ND_GUARDED_BY(mutex_);
  std::weak_ptr<NDHomeManagerDelegate> delegate_ ND_GUARDED_BY(mutex_);
  bool hasReported_ ND_GUARDED_BY(mutex_) = false;
};

}  // namespace nidus
