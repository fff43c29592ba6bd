#pragma once

#include "AssistantHost/SyncClient.h"
#include "HomePlatform/PlatformCall.h"
#include "PlatformModel/System/NDDictionary.h"
#include "PlatformModel/System/NDSystemLog.h"

namespace nidus {

/// Each gives something as it stands in a transcript.

/// A boxed value as it is; null is null.
[[nodiscard]] NDDictionaryValue transcriptOf(const NDValueRef& value);
/// "accessory", "service" and "characteristic".
[[nodiscard]] NDDictionary transcriptOf(const CharacteristicAddress& address);
/// "call", "home", and what was read, written or run.
[[nodiscard]] NDDictionary transcriptOf(const PlatformCall& call);
/// "Level", "Facility" and "Message", each if the message has it.
[[nodiscard]] NDDictionary transcriptOf(const NDSystemLogMessage& message);
/// "after", "object" and "postAnchor", each of which may be null.
[[nodiscard]] NDDictionary transcriptOf(const SyncChange& change);

}  // namespace nidus
