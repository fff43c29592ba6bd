#pragma once

#include "PlatformModel/System/NDExport.h"
#include "PlatformModel/System/NDString.h"
#include "PlatformModel/System/NDValue.h"

namespace nidus {

/// What is known of the device itself. Supplied by the platform; may be called from any thread.
class ND_EXPORT NDDeviceInformation {
 public:
  virtual ~NDDeviceInformation();
  /// Answers `query`, such as "InternalBuild"; null when there is no answer. The answer may be of
  /// any kind.
  [[nodiscard]] virtual NDValueRef answerForQuery(const NDString& query) = 0;
};

}  // namespace nidus
