#pragma once

#include <string>

#include "PlugIn/Performance.h"

namespace nidus {

/// Checks what must hold for every command that a platform with homes has performed: how often it
/// replies, that each reply agrees with its results and with what the homes answered, that results
/// are about the records that the filter has found, that homes are asked at most once of each kind
/// and for no more than was found, and that the homes change as the calls say and in no other way.
/// Gives the first that is broken, for people; empty when all holds.
[[nodiscard]] std::string brokenInvariant(const Performance& performance);

}  // namespace nidus
