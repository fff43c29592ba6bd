#include "Assistant/NDAssistantSyncHome.h"

#include <algorithm>
#include <atomic>
#include <charconv>
#include <chrono>
#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <string>
#include <string_view>
#include <utility>

#include "Assistant/Entities.h"
#include "Logging/WLOLog.h"
#include "PlatformModel/Assistant/VAHAConstants.h"
#include "PlatformModel/Home/NDNAPMetadata.h"
#include "PlatformModel/NDPlatform.h"
#include "PlatformModel/System/NDDeliveryHold.h"
#include "PlatformModel/System/NDSerialQueue.h"

namespace nidus {

/// What belongs to one sync alone.
struct NDAssistantSyncHome::Sync {
  explicit Sync(const std::shared_ptr<NDClock>& clock)
      : group(std::make_shared<NDWaitGroup>(clock)) {}

  std::shared_ptr<NDWaitGroup> group;
  std::shared_ptr<NDAssistantGather> gather;  ///< Null when no homes are configured.
  std::atomic<bool> done = false;

  /// Lets the waiting caller go, unless that has been done. Called on the serial queue.
  void release() {
    if (done) return;
    // Before the leave, so that whoever has waited finds it set.
    done = true;
    group->leave();
  }
};

namespace {

constexpr std::string_view kSyncKey = "com.corvane.nidus.name";
constexpr std::chrono::seconds kLongestWait(2);
constexpr std::uint32_t kFinalAnchor = 0xCAFEBABE;

/// Stops the process unless `isTrue`. Hosts look for operation, file and line, which therefore stay
/// what they are when the code moves.
void require(bool isTrue, const char* operation, int line, const char* condition) {
  if (isTrue) return;
  // A process that is aborted writes no counters of what it has reached.
  std::fprintf(stderr, "*** Assertion failure in %s, %s:%d: %s\n",  // GCOVR_EXCL_LINE
               operation, "Sources/Assistant/NDAssistantSyncHome", line, condition);
  std::abort();  // GCOVR_EXCL_LINE
}

bool isPublished(const HomeObjectRecord& record) {
  if (record.objectType == VAHAEntityTypeTRIGGERValue) return false;
  return record.objectType != VAHAEntityTypeSERVICEValue || record.objectName;
}

NDAssistantSyncHome::Entities publishedEntities(const HomeObjectRecords& records) {
  NDAssistantSyncHome::Entities entities;
  entities.reserve(records.size());
  const auto metadata = NDNAPMetadata::getSharedInstance();
  for (const HomeObjectRecord& record : records) {
    if (isPublished(record)) entities.push_back(entityFromObject(record, metadata.get()));
  }
  return entities;
}

/// The number that `anchor` begins with; 0 when there is none, or one beyond all lists.
std::size_t numberOf(const NDString& anchor) {
  const std::string_view text = anchor.view();
  std::size_t number = 0;
  std::from_chars(text.data(), text.data() + text.size(), number);
  return number;
}

std::size_t countOf(const auto& list) { return list ? list->size() : 0; }

void logAtInfo(const char* text) {
  if (WLOShouldLogAtLevel(6)) WLOLog(6, text, {});
}

}  // namespace

std::shared_ptr<NDAssistantSyncHome> NDAssistantSyncHome::init() {
  const auto platform = NDPlatform::registered();
  if (!platform) return nullptr;
  return std::make_shared<NDAssistantSyncHome>(
      Passkey(), std::make_shared<NDSerialQueue>("NDAssistant", platform->sharedQueue()),
      platform->clock());
}

NDAssistantSyncHome::NDAssistantSyncHome(Passkey /*passkey*/, std::shared_ptr<NDQueue> queue,
                                         std::shared_ptr<NDClock> clock)
    : clock_(std::move(clock)), sync_(std::make_shared<Sync>(clock_)), queue_(std::move(queue)) {}

NDAssistantSyncHome::~NDAssistantSyncHome() { NDAssistantSyncHome::syncDidEnd(); }

void NDAssistantSyncHome::beginSyncWithAnchor_validity_forKey_beginInfo(
    const NDString& /*anchor*/, const NDString& /*validity*/, const NDString& key,
    std::shared_ptr<AFSyncBeginInfo> beginInfo) {
  require(key == kSyncKey, "-[NDAssistantSyncHome beginSyncWithAnchor:validity:forKey:beginInfo:]",
          80, "key == \"com.corvane.nidus.name\"");
  syncDidEnd();
  const NDDeliveryHold hold;
  const auto sync = startSync();
  if (!sync->gather) {
    logAtInfo("No homes configured - short-circuiting sync");
    beginInfo->resetWithValidity(nullptr);
    return;
  }
  sync->group->enter();
  gatherForSync(sync, std::move(beginInfo));
  if (!sync->group->wait(kLongestWait)) logAtInfo("Timed out waiting for nidusd");
  queue()->async([self = shared_from_this(), sync] { self->watch(*sync); });
}

/// Replaces the sync that went before, whose gatherer goes with it.
std::shared_ptr<NDAssistantSyncHome::Sync> NDAssistantSyncHome::startSync() {
  auto sync = std::make_shared<Sync>(clock_);
  sync->gather = NDAssistantGather::init();
  auto former = sync;
  {
    const NDLock lock(mutex_);
    sync_.swap(former);
  }
  return sync;
}

void NDAssistantSyncHome::gatherForSync(const std::shared_ptr<Sync>& sync,
                                        std::shared_ptr<AFSyncBeginInfo> beginInfo) {
  // Weak, both: the handler owns the sync, the sync the gatherer, and the gatherer this callback.
  sync->gather->startWithCompletionHandler([weakSelf = weak_from_this(),
                                            weakSync = std::weak_ptr(sync),
                                            beginInfo = std::move(beginInfo)](long /*count*/) {
    const auto self = weakSelf.lock();
    const auto gathered = weakSync.lock();
    if (!self || !gathered) return;
    self->queue()->async([self, gathered, beginInfo] { self->build(*gathered, *beginInfo); });
  });
}

/// The build task. A late one still publishes and resets: the snapshot is good, only the caller
/// could not wait for it.
void NDAssistantSyncHome::build(Sync& sync, AFSyncBeginInfo& beginInfo) {
  Entities entities = publishedEntities(sync.gather->gatherNidusObjects());
  Anchors anchors;
  anchors.reserve(entities.size());
  for (std::size_t i = 1; i < entities.size(); ++i) anchors.emplace_back(std::to_string(i));
  NDString finalAnchor;
  if (!entities.empty()) {
    finalAnchor = calculateFinalAnchorForHomeObjects(entities);
    anchors.push_back(finalAnchor);
  }
  publish(sync, finalAnchor, std::move(anchors), std::move(entities));
  beginInfo.resetWithValidity(finalAnchor);
  sync.release();
}

/// Sets the lists together, unless the next sync has begun: they are its by then.
void NDAssistantSyncHome::publish(const Sync& sync, const NDString& finalAnchor, Anchors anchors,
                                  Entities entities) {
  const NDLock lock(mutex_);
  if (sync_.get() != &sync) return;
  finalAnchor_ = finalAnchor;
  postAnchors_ = std::move(anchors);
  isNumbered_ = true;
  entities_ = std::move(entities);
}

void NDAssistantSyncHome::watch(Sync& sync) {
  if (sync.done) return;
  logAtInfo("nidusd did not respond");
  sync.release();
}

void NDAssistantSyncHome::getChangeAfterAnchor_changeInfo(const NDString& anchor,
                                                          AFSyncChangeInfo& changeInfo) {
  std::shared_ptr<const VAHAEntity> entity;
  NDString postAnchor = anchor;
  {
    const NDLock lock(mutex_);
    const std::size_t count = countOf(entities_);
    require(countOf(postAnchors_) == count,
            "-[NDAssistantSyncHome getChangeAfterAnchor:changeInfo:]", 173,
            "_postAnchors.count == _entities.count");
    const std::size_t index = anchor && anchor == finalAnchor_ ? count : indexAfter(anchor);
    if (index < count) {
      entity = (*entities_)[index];
      postAnchor = (*postAnchors_)[index];
    }
  }
  changeInfo.setObject(std::move(entity));
  changeInfo.setPostAnchor(postAnchor);
}

/// The place after the first anchor that equals `anchor`: the first place for null, one beyond the
/// last when no anchor does.
std::size_t NDAssistantSyncHome::indexAfter(const NDString& anchor) const {
  if (!anchor || !postAnchors_) return 0;
  const Anchors& anchors = *postAnchors_;
  // What a sync published says its place itself. A list that was set from outside may say any.
  const std::size_t number = isNumbered_ ? numberOf(anchor) : 0;
  if (number > 0 && number <= anchors.size() && anchors[number - 1] == anchor) return number;
  const auto found = std::find(anchors.begin(), anchors.end(), anchor);
  return static_cast<std::size_t>(found - anchors.begin()) + 1;
}

void NDAssistantSyncHome::syncDidEnd() {
  // Together, so that a late build task comes before or after all of them. What they held goes
  // after the lock.
  std::optional<Anchors> anchors;
  std::optional<Entities> entities;
  const NDLock lock(mutex_);
  finalAnchor_ = nullptr;
  postAnchors_.swap(anchors);
  entities_.swap(entities);
}

NDString NDAssistantSyncHome::calculateFinalAnchorForHomeObjects(
    const Entities& /*entities*/) const {
  return std::to_string(kFinalAnchor);
}

bool NDAssistantSyncHome::done() const {
  const NDLock lock(mutex_);
  return sync_->done;
}
void NDAssistantSyncHome::setDone(bool done) {
  const NDLock lock(mutex_);
  sync_->done = done;
}

NDString NDAssistantSyncHome::finalAnchor() const {
  const NDLock lock(mutex_);
  return finalAnchor_;
}
void NDAssistantSyncHome::setFinalAnchor(NDString anchor) {
  const NDLock lock(mutex_);
  finalAnchor_ = std::move(anchor);
}

std::optional<NDAssistantSyncHome::Anchors> NDAssistantSyncHome::postAnchors() const {
  const NDLock lock(mutex_);
  return postAnchors_;
}
void NDAssistantSyncHome::setPostAnchors(std::optional<Anchors> anchors) {
  const NDLock lock(mutex_);
  postAnchors_.swap(anchors);
  isNumbered_ = false;
}

std::optional<NDAssistantSyncHome::Entities> NDAssistantSyncHome::entities() const {
  const NDLock lock(mutex_);
  return entities_;
}
void NDAssistantSyncHome::setEntities(std::optional<Entities> entities) {
  const NDLock lock(mutex_);
  entities_.swap(entities);
}

std::shared_ptr<NDWaitGroup> NDAssistantSyncHome::group() const {
  const NDLock lock(mutex_);
  return sync_->group;
}
void NDAssistantSyncHome::setGroup(std::shared_ptr<NDWaitGroup> group) {
  const NDLock lock(mutex_);
  sync_->group.swap(group);
}

std::shared_ptr<NDAssistantGather> NDAssistantSyncHome::gather() const {
  const NDLock lock(mutex_);
  return sync_->gather;
}
void NDAssistantSyncHome::setGather(std::shared_ptr<NDAssistantGather> gather) {
  const NDLock lock(mutex_);
  sync_->gather.swap(gather);
}

std::shared_ptr<NDQueue> NDAssistantSyncHome::queue() const {
  const NDLock lock(mutex_);
  return queue_;
}
void NDAssistantSyncHome::setQueue(std::shared_ptr<NDQueue> queue) {
  const NDLock lock(mutex_);
  queue_.swap(queue);
}

std::shared_ptr<NDHomeManager> NDAssistantSyncHome::manager() const {
  const NDLock lock(mutex_);
  return manager_;
}
void NDAssistantSyncHome::setManager(std::shared_ptr<NDHomeManager> manager) {
  const NDLock lock(mutex_);
  manager_.swap(manager);
}

}  // namespace nidus
