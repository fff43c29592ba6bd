#pragma once

#include <optional>
#include <string>
#include <vector>

#include "Load/Ledger.h"
#include "Load/LoadCommand.h"
#include "PlatformModel/System/NDDictionary.h"

namespace nidus {

using Replies = std::vector<NDDictionary>;

/// What is wrong with all the replies of a command that is over; empty when nothing is.
///
/// With `facts` the number of replies, their outcomes and the number of results of each outcome
/// have to be exactly those that follow from what the platform has done. Without, every home has
/// answered, and at most one was asked.
[[nodiscard]] std::vector<std::string> judge(const LoadCommand& command,
                                             const std::optional<PlatformFacts>& facts,
                                             const Replies& replies);

/// The text at `key`; null when there is none.
[[nodiscard]] NDString textOf(const NDDictionary& dictionary, std::string_view key);
/// The results of a reply.
[[nodiscard]] std::vector<NDDictionary> resultsOf(const NDDictionary& reply);

}  // namespace nidus
