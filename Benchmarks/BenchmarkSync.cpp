#include "BenchmarkSync.h"

#include "Support/PulledChange.h"

namespace nidus {
namespace {

class BeginInfo final : public AFSyncBeginInfo {
 public:
  void resetWithValidity(const NDString& /*validity*/) override {}
};

}  // namespace

void BenchmarkSync::begin(const BenchmarkPlatform& platform) const {
  handler_->beginSyncWithAnchor_validity_forKey_beginInfo(
      nullptr, nullptr, "com.corvane.nidus.name", std::make_shared<BeginInfo>());
  platform.drain();
}

std::size_t BenchmarkSync::pullAll() const {
  PulledChange info;
  std::size_t entities = 0;
  for (;;) {
    handler_->getChangeAfterAnchor_changeInfo(info.postAnchor, info);
    if (!info.entity) return entities;
    ++entities;
  }
}

std::shared_ptr<const VAHAEntity> BenchmarkSync::pullAfter(const NDString& anchor) const {
  PulledChange info;
  handler_->getChangeAfterAnchor_changeInfo(anchor, info);
  return info.entity;
}

}  // namespace nidus
