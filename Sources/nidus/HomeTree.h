#pragma once

#include <string>

#include "HomePlatform/Store/HomeData.h"
#include "nidus/HomeWords.h"
#include "nidus/Terminal/Terminal.h"

namespace nidus {

/// Draws a home as a tree for people, several lines each with its end: the rooms with their
/// accessories, the services with the values that the platform knew last, and the zones, groups,
/// scenes and triggers. `words` are those of its platform. Lines are broken at the terminal's
/// width.
[[nodiscard]] std::string homeTree(const HomeData& home, const HomeWords& words,
                                   const TerminalStyle& style);

}  // namespace nidus
