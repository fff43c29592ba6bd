#pragma once

#include <memory>
#include <utility>

#include "PlatformModel/Assistant/AFSyncHandler.h"

namespace nidus {

/// Keeps what was pulled from a sync last. Not synchronised.
class PulledChange final : public AFSyncChangeInfo {
 public:
  void setObject(std::shared_ptr<const VAHAEntity> object) override { entity = std::move(object); }
  void setPostAnchor(const NDString& anchor) override { postAnchor = anchor; }

  std::shared_ptr<const VAHAEntity> entity;  ///< Null at the end.
  NDString postAnchor;
};

}  // namespace nidus
