#pragma once

#include <functional>
#include <memory>

#include "Assistant/HomeObjectRecord.h"
#include "PlatformModel/Home/NDHomeManager.h"
#include "PlatformModel/System/NDMutex.h"
#include "PlatformModel/System/NDString.h"
#include "PlatformModel/System/NDURL.h"

namespace nidus {

/// Reads the home database: waits for the first list of homes and flattens it into a snapshot.
///
/// One gatherer serves one command or one sync. It owns its manager; the manager does not own it.
///
///     auto gather = NDAssistantGather::init();      // null: no homes are configured
///     gather->startWithCompletionHandler([gather](long count) { ... });
class NDAssistantGather final : public NDHomeManagerDelegate {
  struct Passkey {};

 public:
  /// Takes the number of homes.
  using CompletionHandler = std::function<void(long count)>;

  /// Makes a gatherer and starts the load of the homes; null when no homes are configured. Callers
  /// hold an `NDDeliveryHold` until they have called `startWithCompletionHandler`.
  [[nodiscard]] static std::shared_ptr<NDAssistantGather> init();

  /// For `init` alone.
  NDAssistantGather(Passkey passkey, std::shared_ptr<NDHomeManager> manager);

  /// Whether the homes have been reported; once true it stays so. May be called from any thread.
  [[nodiscard]] bool fetchComplete() const;
  /// Never null. May be called from any thread.
  [[nodiscard]] const std::shared_ptr<NDHomeManager>& manager() const noexcept { return manager_; }
  /// What waits for the first update; empty before the start and from the update on.
  [[nodiscard]] CompletionHandler completionHandler() const;

  /// Keeps `handler` (never empty) for the first update of the homes, in the place of an earlier
  /// one; when the update has been, calls it at once with 0. It runs once, on the platform's thread
  /// of deliveries or on the caller's, and is then let go; after the platform has been shut down it
  /// never runs.
  void startWithCompletionHandler(CompletionHandler handler);

  void homeManagerDidUpdateHomes(const std::shared_ptr<NDHomeManager>& manager) override;
  void homeManagerWillNotUpdateHomes(const std::shared_ptr<NDHomeManager>& manager) override;

  /// The name, or the UUID's text, of the first primary home; null without one.
  [[nodiscard]] NDString getPrimaryHomeName() const;
  [[nodiscard]] NDString getPrimaryHomeID() const;

  /// Flattens all homes, in the platform's order: of each the home, its services, groups, rooms,
  /// zones, scenes and triggers.
  [[nodiscard]] HomeObjectRecords gatherNidusObjects() const;

  /// Append one record (or, for a service that the assistant cannot address, none) to `list`.
  /// `home` may be null; the other arguments may not.
  void addToList_objectWithName_type_home_andIdentifer(HomeObjectRecords& list,
                                                       const NDString& name, const NDString& type,
                                                       const NDString& home,
                                                       NDURL identifier) const;
  void addToList_room(HomeObjectRecords& list, const NDRoom& room) const;
  void addToList_service(HomeObjectRecords& list, const std::shared_ptr<NDService>& service) const;

 private:
  const std::shared_ptr<NDHomeManager> manager_;
  mutable NDMutex mutex_;
  bool fetchComplete_ ND_GUARDED_BY(mutex_) = false;
  bool isAbandoned_ ND_GUARDED_BY(mutex_) = false;
  CompletionHandler completionHandler_ ND_GUARDED_BY(mutex_);
};

}  // namespace nidus
