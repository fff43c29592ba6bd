#pragma once

#include <ctime>
#include <string>

#include "HomePlatform/Metadata/Vocabulary.h"
#include "nidus/Terminal/Terminal.h"
#include "nidus/Watch/HomeChange.h"

namespace nidus {

/// A change for people, one line with its end: "14:03:07  Cottage / Kitchen / Lamp / Bulb
/// BRIGHTNESS  40 % -> 65 %". `time` is when it was seen.
[[nodiscard]] std::string changeText(const HomeChange& change, std::time_t time,
                                     const Vocabulary& vocabulary, const TerminalStyle& style);

/// The same for programs: one JSON object on one line with its end, with the time in UTC.
[[nodiscard]] std::string changeJson(const HomeChange& change, std::time_t time);

}  // namespace nidus
