#pragma once

#include <memory>
#include <optional>
#include <vector>

#include "Assistant/NDAssistantGather.h"
#include "PlatformModel/Assistant/AFSyncHandler.h"
#include "PlatformModel/Home/NDHomeManager.h"
#include "PlatformModel/System/NDClock.h"
#include "PlatformModel/System/NDMutex.h"
#include "PlatformModel/System/NDQueue.h"
#include "PlatformModel/System/NDString.h"
#include "PlatformModel/System/NDWaitGroup.h"

namespace nidus {

/// Serves the names of the homes to the assistant's recogniser: each sync takes a snapshot and
/// publishes it whole, one entity per request.
///
/// The operations of `AFSyncHandler` run on the assistant's thread; the begin blocks it for at most
/// two seconds. Entities are built on the handler's serial queue, each sync by tasks of its own: a
/// sync that is late never touches the lists of the next one. The properties may be read from
/// any thread, and set from any thread while no sync runs.
///
///     auto handler = NDAssistantSyncHome::init();
///     handler->beginSyncWithAnchor_validity_forKey_beginInfo(nullptr, nullptr,
///                                                            "com.corvane.nidus.name", beginInfo);
///     handler->getChangeAfterAnchor_changeInfo(nullptr, changeInfo);
class NDAssistantSyncHome final : public AFSyncHandler,
                                  public std::enable_shared_from_this<NDAssistantSyncHome> {
  struct Passkey {};

 public:
  /// Anchors and entities; none is null.
  using Anchors = std::vector<NDString>;
  using Entities = std::vector<std::shared_ptr<const VAHAEntity>>;

  /// Makes a handler; null when no platform is registered.
  [[nodiscard]] static std::shared_ptr<NDAssistantSyncHome> init();
  /// For `init` alone.
  NDAssistantSyncHome(Passkey passkey, std::shared_ptr<NDQueue> queue,
                      std::shared_ptr<NDClock> clock);
  ~NDAssistantSyncHome() override;

  /// Opens a sync; `anchor` and `validity` are not consulted, each sync is a full reset. Any key
  /// but "com.corvane.nidus.name" stops the process with a message on standard error.
  void beginSyncWithAnchor_validity_forKey_beginInfo(
      const NDString& anchor, const NDString& validity, const NDString& key,
      std::shared_ptr<AFSyncBeginInfo> beginInfo) override;
  /// Fills in the entity that follows `anchor`; an unknown anchor, as well as the last one, is
  /// answered with the end of the data.
  void getChangeAfterAnchor_changeInfo(const NDString& anchor,
                                       AFSyncChangeInfo& changeInfo) override;
  void syncDidEnd() override;

  /// Gives the anchor of the last entity, which is the validity too: the same for all homes, so
  /// `entities` is not consulted.
  [[nodiscard]] NDString calculateFinalAnchorForHomeObjects(const Entities& entities) const;

  /// Whether the wait of the current sync has been released.
  [[nodiscard]] bool done() const;
  void setDone(bool done);
  /// The anchor of the last entity; null before and after a sync, and when there are no entities.
  [[nodiscard]] NDString finalAnchor() const;
  void setFinalAnchor(NDString anchor);
  /// The anchor that follows each entity; none before and after a sync.
  [[nodiscard]] std::optional<Anchors> postAnchors() const;
  void setPostAnchors(std::optional<Anchors> anchors);
  /// What the current sync publishes; none before and after a sync.
  [[nodiscard]] std::optional<Entities> entities() const;
  void setEntities(std::optional<Entities> entities);
  /// Joins the begin of the current sync with its build task; never null.
  [[nodiscard]] std::shared_ptr<NDWaitGroup> group() const;
  void setGroup(std::shared_ptr<NDWaitGroup> group);
  /// The gatherer of the current sync; may be null.
  [[nodiscard]] std::shared_ptr<NDAssistantGather> gather() const;
  void setGather(std::shared_ptr<NDAssistantGather> gather);
  /// Where the tasks of all syncs run, one after the other; never null.
  [[nodiscard]] std::shared_ptr<NDQueue> queue() const;
  void setQueue(std::shared_ptr<NDQueue> queue);
  /// Kept for those who set it; syncs do not use it. May be null.
  [[nodiscard]] std::shared_ptr<NDHomeManager> manager() const;
  void setManager(std::shared_ptr<NDHomeManager> manager);

 private:
  struct Sync;

  [[nodiscard]] std::shared_ptr<Sync> startSync();
  void gatherForSync(const std::shared_ptr<Sync>& sync, std::shared_ptr<AFSyncBeginInfo> beginInfo);
  void build(Sync& sync, AFSyncBeginInfo& beginInfo);
  void publish(const Sync& sync, const NDString& finalAnchor, Anchors anchors, Entities entities);
  void watch(Sync& sync);
  [[nodiscard]] std::size_t indexAfter(const NDString& anchor) const ND_REQUIRES(mutex_);

  const std::shared_ptr<NDClock> clock_;
  mutable NDMutex mutex_;
  std::shared_ptr<Sync> sync_ ND_GUARDED_BY(mutex_);
  NDString finalAnchor_ ND_GUARDED_BY(mutex_);
  std::optional<Anchors> postAnchors_ ND_GUARDED_BY(mutex_);
  /// Whether the anchors are those of a sync, each of which but the last is its own place.
  bool isNumbered_ ND_GUARDED_BY(mutex_) = false;
  std::optional<Entities> entities_ ND_GUARDED_BY(mutex_);
  std::shared_ptr<NDQueue> queue_ ND_GUARDED_BY(mutex_);
  std::shared_ptr<NDHomeManager> manager_ ND_GUARDED_BY(mutex_);
};

}  // namespace nidus
