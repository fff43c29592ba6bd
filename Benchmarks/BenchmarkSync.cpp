#include "BenchmarkSync.h"

#include <utility>

namespace nidus {
namespace {

class BeginInfo final : public AFSyncBeginInfo {
 public:
  void resetWithValidity(const NDString& /*validity*/) override {}
};

/// Keeps what was pulled last.
class ChangeInfo final : public AFSyncChangeInfo {
 public:
  void setObject(std::shared_ptr<const VAHAEntity> object) override { entity = std::move(object); }
  void setPostAnchor(const NDString& anchor) override { postAnchor = anchor; }

  std::shared_ptr<const VAHAEntity> entity;
  NDString postAnchor;
};

}  // namespace

void BenchmarkSync::begin(const BenchmarkPlatform& platform) const {
  handler_->beginSyncWithAnchor_validity_forKey_beginInfo(
      nullptr, nullptr, "com.corvane.nidus.name", std::make_shared<BeginInfo>());
  platform.drain();
}

std::size_t BenchmarkSync::pullAll() const {
  ChangeInfo info;
  std::size_t entities = 0;
  for (;;) {
    handler_->getChangeAfterAnchor_changeInfo(info.postAnchor, info);
    if (!info.entity) return entities;
    ++entities;
  }
}

std::shared_ptr<const VAHAEntity> BenchmarkSync::pullAfter(const NDString& anchor) const {
  ChangeInfo info;
  handler_->getChangeAfterAnchor_changeInfo(anchor, info);
  return info.entity;
}

}  // namespace nidus
