#pragma once

#include <vector>

#include "nidus/Doctor/Examination.h"
#include "nidus/Doctor/Finding.h"

namespace nidus {

/// Runs all checks that have something to look at; one entry for each, healthy areas included.
[[nodiscard]] std::vector<AreaFindings> diagnose(const Examination& examination);

}  // namespace nidus
