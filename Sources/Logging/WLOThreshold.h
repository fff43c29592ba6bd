#pragma once

#include "PlatformModel/Assistant/NDLogThreshold.h"
#include "PlatformModel/NDPlatform.h"

namespace nidus {

/// Reads from the preferences of `platform`, as they are now, which messages are to be logged.
/// Whether the device runs an internal build is asked once per process. Changes nothing that is
/// logged. May be called from any thread.
[[nodiscard]] NDLogThreshold readThreshold(NDPlatform& platform);

}  // namespace nidus
