#pragma once

#include <vector>

#include "HomePlatform/Result.h"
#include "HomePlatform/Store/HomeData.h"

namespace nidus {

/// The homes as they are to be after a person has edited them: `edited`, with the values that are
/// `current` wherever the person left those of `exported` alone. A failure, as bad input, says that
/// the current homes differ from the exported ones in more than values: somebody else has changed
/// them meanwhile. Homes that are moved here are copied nowhere.
[[nodiscard]] Result<std::vector<HomeData>> mergeEdit(std::vector<HomeData> exported,
                                                      std::vector<HomeData> edited,
                                                      std::vector<HomeData> current);

}  // namespace nidus
