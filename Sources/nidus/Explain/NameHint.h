#pragma once

#include <string>
#include <vector>

#include "HomePlatform/HomePlatform.h"
#include "PlatformModel/Assistant/VAHAFilter.h"
#include "PlatformModel/System/NDDictionary.h"

namespace nidus {

/// Says of a name that led to nothing whether there is such a name, what was perhaps meant, and
/// which ones there are: "There is no room Kitchn here; did you mean Kitchen? There are: Kitchen,
/// Hall." One line; `noun` is what `name` should be the name of.
[[nodiscard]] std::string nameHint(const std::string& noun, const NDString& name,
                                   const std::vector<std::string>& known);

/// The hints about what a step of `filter` asked for in vain, by the plug-in's name of the step:
/// `snapshot` are all records, `before` those that the step dropped.
[[nodiscard]] std::string nameHints(const VAHASearchCriteriaFilter& filter, const std::string& step,
                                    const NDDictionaryList& snapshot,
                                    const NDDictionaryList& before, const NDNAPMetadata& metadata);

/// The attributes of the services among records, each once.
[[nodiscard]] std::vector<std::string> attributesOf(const NDDictionaryList& records,
                                                    const NDNAPMetadata& metadata);

}  // namespace nidus
