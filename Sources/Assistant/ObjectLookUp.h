#pragma once

#include <memory>

#include "Assistant/HomeObjectRecord.h"
#include "Assistant/NDAssistantGather.h"
#include "PlatformModel/Home/NDHome.h"
#include "PlatformModel/System/NDString.h"
#include "PlatformModel/System/NDURL.h"

namespace nidus {

/// Splits an identifier URL into its parts. A URL of another scheme clears all four outputs first
/// and is parsed all the same; a key that is missing leaves its output as it was, so callers set
/// all four to null beforehand. `identifier` may not be null.
/// Throws `std::out_of_range` for a path of fewer than two components, and for a query that ends
/// with a key that has no value; only identifiers that the plug-in made are ever split.
void splitIdentifier(const NDURL& identifier, NDString& kind, NDString& objectID, NDString& home,
                     NDString& accessory);

/// Finds the live service, or action set, of a record among the homes that the gatherer's manager
/// has now; null when it is not there or the record is of another kind. `gather` may be null.
[[nodiscard]] std::shared_ptr<NDService> serviceFromObject(
    const HomeObjectRecord& record, const std::shared_ptr<NDAssistantGather>& gather);
[[nodiscard]] std::shared_ptr<NDActionSet> actionSetFromObject(
    const HomeObjectRecord& record, const std::shared_ptr<NDAssistantGather>& gather);

}  // namespace nidus
