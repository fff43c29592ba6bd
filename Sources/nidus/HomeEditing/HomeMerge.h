#pragma once

#include <vector>

#include "HomePlatform/Result.h"
#include "HomePlatform/Store/HomeData.h"

namespace nidus {

/// The homes as they are to be after a person has edited them: `edited`, with the values that are
/// `current` wherever the person left those of `exported` alone. A failure, as bad input, says that
/// the current homes differ from the exported ones in more than values: somebody else has changed
/// them meanwhile.
[[nodiscard]] Result<std::vector<HomeData>> mergeEdit(const std::vector<HomeData>& exported,
                                                      std::vector<HomeData> edited,
                                                      const std::vector<HomeData>& current);

}  // namespace nidus
