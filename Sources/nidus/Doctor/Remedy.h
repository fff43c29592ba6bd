#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "HomePlatform/Result.h"
#include "HomePlatform/Store/HomeData.h"
#include "nidus/Doctor/Finding.h"

namespace nidus {

/// `text` as one word of a shell's command line, in quotes where it needs them.
[[nodiscard]] std::string shellWord(std::string_view text);

/// Such as " --home 'Beach House'", for a command about an object of `home`; empty where it is the
/// only one of `homes`.
[[nodiscard]] std::string homeOption(const std::vector<HomeData>& homes, const HomeData& home);

/// What is found where the platform or the module gives `failure`, whose message ends with the
/// remedy.
[[nodiscard]] Finding findingOf(const Failure& failure);

}  // namespace nidus
