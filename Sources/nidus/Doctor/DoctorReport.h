#pragma once

#include <string>
#include <vector>

#include "nidus/Doctor/Finding.h"
#include "nidus/Terminal/Terminal.h"

namespace nidus {

/// Whether there is nothing but notes.
[[nodiscard]] bool isWell(const std::vector<AreaFindings>& areas);

/// For people: a line for each area, below it one for each finding, and a sentence at the end.
[[nodiscard]] std::string doctorText(const std::vector<AreaFindings>& areas,
                                     const TerminalStyle& style);

/// For programs: one JSON object on one line.
[[nodiscard]] std::string doctorJson(const std::vector<AreaFindings>& areas);

}  // namespace nidus
