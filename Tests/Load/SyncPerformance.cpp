#include <string>
#include <utility>

#include "Assistant/NDAssistantSyncHome.h"
#include "Load/Performance.h"
#include "PlatformModel/Assistant/VAHAConstants.h"
#include "Support/PulledChange.h"

namespace nidus {
namespace {

constexpr const char* kKey = "com.corvane.nidus.name";
constexpr const char* kFinalAnchor = "3405691582";

/// Takes the resets of one sync, which can not be reset any more when this is destroyed.
class BeginInfo final : public AFSyncBeginInfo {
 public:
  explicit BeginInfo(StressRecord& record) : record_(record) {}
  ~BeginInfo() override { record_.expect(resets().size() <= 1, "a reset too many", "a sync"); }
  BeginInfo(const BeginInfo&) = delete;
  BeginInfo& operator=(const BeginInfo&) = delete;

  void resetWithValidity(const NDString& validity) override {
    ++record_.resets;
    const NDLock lock(mutex_);
    resets_.push_back(validity);
  }
  [[nodiscard]] std::vector<NDString> resets() {
    const NDLock lock(mutex_);
    return resets_;
  }

 private:
  StressRecord& record_;
  NDMutex mutex_;
  std::vector<NDString> resets_ ND_GUARDED_BY(mutex_);
};

using Entities = std::vector<std::shared_ptr<const VAHAEntity>>;

/// Asks for one change after the other. The anchors count up to the last one, which is final; a
/// handler whose homes come while it is asked has nothing first and everything then.
Entities pull(NDAssistantSyncHome& handler, StressRecord& record) {
  Entities entities;
  PulledChange change;
  NDString anchor;
  for (;;) {
    handler.getChangeAfterAnchor_changeInfo(anchor, change);
    if (!change.entity) break;
    entities.push_back(change.entity);
    anchor = change.postAnchor;
    const bool isCounted = anchor == NDString(std::to_string(entities.size()));
    record.expect(isCounted || anchor == kFinalAnchor, "an anchor is out of order", "a sync");
  }
  record.expect(entities.empty() || anchor == kFinalAnchor, "entities are missing", "a sync");
  record.expect(change.postAnchor == anchor, "the end has an anchor of its own", "a sync");
  return entities;
}

void judgeEntities(const Entities& entities, StressRecord& record) {
  for (const auto& entity : entities) {
    record.expect(entity->name() && entity->entityType(), "an entity without a name", "a sync");
    record.expect(entity->entityType() != VAHAEntityTypeTRIGGERValue, "a trigger", "a sync");
  }
}

/// What the sync must have told its begin info by the time the begin returns.
void judgeBegin(const std::vector<NDString>& resets, const PlatformFacts& facts,
                StressRecord& record) {
  if (facts.hasTimedOut) return;
  record.expect(resets.size() == 1, "a sync is not reset in time", "a sync");
  if (resets.empty() || facts.wasAskedForHomes) return;
  record.expect(!resets.front(), "a validity without homes", "a sync");
}

}  // namespace

Entities performSync(StressRecord& record, const std::shared_ptr<Ledger>& ledger) {
  ++record.syncs;
  const Ledger::Scope scope(ledger);
  const auto handler = NDAssistantSyncHome::init();
  auto begin = std::make_shared<BeginInfo>(record);
  record.lives.add("sync handlers", handler);
  record.lives.add("sync begins", begin);
  handler->beginSyncWithAnchor_validity_forKey_beginInfo(nullptr, nullptr, kKey, begin);
  const auto resets = begin->resets();
  judgeBegin(resets, ledger ? ledger->facts() : PlatformFacts{.wasAskedForHomes = true}, record);
  Entities entities = pull(*handler, record);
  judgeEntities(entities, record);
  if (!resets.empty()) {
    record.expect(resets.front() == (entities.empty() ? nullptr : NDString(kFinalAnchor)),
                  "the validity does not agree with the entities", "a sync");
  }
  handler->syncDidEnd();
  record.expect(pull(*handler, record).empty(), "entities after the end", "a sync");
  return entities;
}

}  // namespace nidus
