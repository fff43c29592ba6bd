#include "AssistantHost/SyncClient.h"

#include <string>
#include <utility>

#include "PlatformModel/Assistant/AFSyncHandler.h"
#include "PlatformModel/System/NDMutex.h"

namespace nidus {
namespace {

class ChangeInfo final : public AFSyncChangeInfo {
 public:
  explicit ChangeInfo(SyncChange& change) : change_(change) {}
  void setObject(std::shared_ptr<const VAHAEntity> object) override {
    change_.object = std::move(object);
  }
  void setPostAnchor(const NDString& anchor) override { change_.postAnchor = anchor; }

 private:
  SyncChange& change_;
};

}  // namespace

class SyncClient::BeginInfo final : public AFSyncBeginInfo {
 public:
  void resetWithValidity(const NDString& validity) override {
    const NDLock lock(mutex_);
    resets_.push_back(validity);
  }
  [[nodiscard]] std::vector<NDString> resets() {
    const NDLock lock(mutex_);
    return resets_;
  }

 private:
  NDMutex mutex_;
  std::vector<NDString> resets_ ND_GUARDED_BY(mutex_);
};

Result<std::shared_ptr<SyncClient>> SyncClient::make(const NDAssistantModule& module) {
  std::string message;
  auto handler = module.makeSyncHandler(message);
  if (!handler) return Failure{Failure::Kind::platform, message};
  return std::shared_ptr<SyncClient>(new SyncClient(std::move(handler)));
}

SyncClient::SyncClient(std::shared_ptr<AFSyncHandler> handler)
    : handler_(std::move(handler)), beginInfo_(std::make_shared<BeginInfo>()) {}

void SyncClient::begin(const NDString& key, const NDString& anchor, const NDString& validity) {
  handler_->beginSyncWithAnchor_validity_forKey_beginInfo(anchor, validity, key, beginInfo_);
}

SyncChange SyncClient::changeAfter(const NDString& anchor) {
  SyncChange change{anchor, nullptr, nullptr};
  ChangeInfo info(change);
  handler_->getChangeAfterAnchor_changeInfo(anchor, info);
  return change;
}

std::vector<SyncChange> SyncClient::allChanges() {
  std::vector<SyncChange> changes = {changeAfter(nullptr)};
  while (changes.back().object) changes.push_back(changeAfter(changes.back().postAnchor));
  return changes;
}

void SyncClient::end() { handler_->syncDidEnd(); }

std::vector<NDString> SyncClient::resets() const { return beginInfo_->resets(); }

NDDictionaryValue entityValue(const std::shared_ptr<const VAHAEntity>& entity) {
  return entity ? NDDictionaryValue(entity->dictionary()) : NDDictionaryValue();
}

}  // namespace nidus
