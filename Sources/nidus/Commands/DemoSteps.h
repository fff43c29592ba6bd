#pragma once

#include <string_view>
#include <vector>

#include "nidus/ExitStatus.h"

namespace nidus {

/// One stop of the tour.
struct DemoStep {
  std::string_view title;  ///< What it shows.
  std::string_view line;   ///< The order as a person types it, without the program's name.
  ExitStatus expected = ExitStatus::success;
};

/// The stops in order, made for the demonstration home.
[[nodiscard]] const std::vector<DemoStep>& demoSteps();

}  // namespace nidus
