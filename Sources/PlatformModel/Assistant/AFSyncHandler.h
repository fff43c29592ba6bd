#pragma once

#include <memory>

#include "PlatformModel/Assistant/VAHAEntity.h"
#include "PlatformModel/System/NDExport.h"
#include "PlatformModel/System/NDString.h"

namespace nidus {

/// Takes the answer to the begin of a sync. Implemented by the assistant.
class ND_EXPORT AFSyncBeginInfo {
 public:
  virtual ~AFSyncBeginInfo();
  /// The assistant's copy is to be replaced; `validity` may be null. Called on the thread of the
  /// begin or on a queue of the platform, also after the begin has returned.
  virtual void resetWithValidity(const NDString& validity) = 0;
};

/// Takes the answer to one request for a change. Implemented by the assistant; called on the thread
/// of the request, within it.
class ND_EXPORT AFSyncChangeInfo {
 public:
  virtual ~AFSyncChangeInfo();
  /// The entity to publish; null at the end of the data.
  virtual void setObject(std::shared_ptr<const VAHAEntity> object) = 0;
  /// The anchor that follows; may be null.
  virtual void setPostAnchor(const NDString& anchor) = 0;
};

/// Serves the assistant's anchor-based sync. Called by one thread of the assistant at a time.
class ND_EXPORT AFSyncHandler {
 public:
  virtual ~AFSyncHandler();
  /// Opens a sync. `anchor` and `validity` may be null, `key` and `beginInfo` may not.
  virtual void beginSyncWithAnchor_validity_forKey_beginInfo(
      const NDString& anchor, const NDString& validity, const NDString& key,
      std::shared_ptr<AFSyncBeginInfo> beginInfo) = 0;
  /// Asks for the change that follows `anchor`, which may be null.
  virtual void getChangeAfterAnchor_changeInfo(const NDString& anchor,
                                               AFSyncChangeInfo& changeInfo) = 0;
  /// Ends the sync.
  virtual void syncDidEnd() = 0;
};

}  // namespace nidus
