#pragma once

#include <cstddef>
#include <string>
#include <vector>

#include "PlugIn/AccessoryModel.h"
#include "PlugIn/Performance.h"
#include "PlugIn/Reply.h"

namespace nidus {

/// The family of an action's type.
enum class ActionFamily { read, limit, set, update, unknown };
/// The family of the first action; a type that is missing reads.
[[nodiscard]] ActionFamily familyOf(const VAHACommand& command);

/// The first action; null without one.
[[nodiscard]] VAHAActionRef firstAction(const VAHACommand& command);

/// What the replies to a command that has asked homes must say, made out of what the homes answer.
struct Expectation {
  std::size_t unlockReplies = 0;  ///< How many replies ask for the device to be unlocked.
  bool hasReport = true;          ///< Whether a reply with results follows.
  OutcomeCounts outcomes;         ///< Of the results.
  std::string broken;             ///< What the calls themselves break; empty when nothing.
  std::vector<HomeData> homes;    ///< As they must be afterwards.
};

/// Follows the calls of a command, one by one.
[[nodiscard]] Expectation expectationOf(const Performance& performance);

}  // namespace nidus
