#pragma once

#include <string>
#include <vector>

#include "PlatformModel/System/NDDictionary.h"
#include "nidus/Orders/Order.h"
#include "nidus/Terminal/Terminal.h"

namespace nidus {

/// The replies to one command, in the order in which they came; empty when there was none.
using Replies = std::vector<NDDictionary>;

/// Shows the answer to an order to a person: for each reply a table of the objects and one sentence
/// about the outcome. `replies` has one entry for each command of the order.
[[nodiscard]] std::string answerText(const Order& order, const std::vector<Replies>& replies,
                                     const TerminalStyle& style);

}  // namespace nidus
