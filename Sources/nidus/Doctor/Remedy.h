#pragma once

#include <string>
#include <string_view>

#include "HomePlatform/Result.h"
#include "nidus/Doctor/Finding.h"

namespace nidus {

/// `text` as one word of a shell's command line, in quotes where it needs them.
[[nodiscard]] std::string shellWord(std::string_view text);

/// What is found where the platform or the module gives `failure`, whose message ends with the
/// remedy.
[[nodiscard]] Finding findingOf(const Failure& failure);

}  // namespace nidus
