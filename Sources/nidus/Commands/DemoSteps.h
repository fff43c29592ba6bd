#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "PlatformModel/System/NDDictionary.h"

namespace nidus {

/// One command of the demonstration.
struct DemoStep {
  std::string_view title;     ///< What it shows.
  bool isLocked = false;      ///< Whether the device is locked meanwhile.
  std::string_view command;   ///< As JSON.
  std::string_view expected;  ///< The summary of its replies.
};

/// The commands in order, made for the demonstration home.
[[nodiscard]] const std::vector<DemoStep>& demoSteps();

/// Replies in short: the outcome of each, then name, outcome and value of each of its results.
[[nodiscard]] std::string summaryOf(const std::vector<NDDictionary>& replies);

}  // namespace nidus
