#pragma once

#include <memory>
#include <string_view>

#include "HomePlatform/Metadata/Vocabulary.h"
#include "HomePlatform/Result.h"
#include "PlatformModel/Assistant/VAHAFilter.h"
#include "nidus/Orders/Order.h"

namespace nidus {

/// A search filter that nobody changes any more; never null.
using SearchFilterRef = std::shared_ptr<const VAHASearchCriteriaFilter>;

/// Turns what a person said into a search filter. Without a word about the kind of object it finds
/// services, or scenes where a scene is named: an order for everything in a room is for what can
/// do it, and other objects must not get in its way. A failure is bad input and names the word.
[[nodiscard]] Result<SearchFilterRef> searchFilter(const OrderFilter& filter,
                                                   const Vocabulary& vocabulary);

}  // namespace nidus
