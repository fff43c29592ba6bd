#pragma once

#include <string>
#include <vector>

#include "HomePlatform/Metadata/Vocabulary.h"
#include "PlatformModel/System/NDDictionary.h"
#include "nidus/Orders/Order.h"
#include "nidus/Terminal/Terminal.h"

namespace nidus {

/// The replies to one command, in the order in which they came; empty when there was none.
using Replies = std::vector<NDDictionary>;

/// Whether all that the plug-in replied is that nothing matches.
[[nodiscard]] bool isAllWithoutMatch(const std::vector<Replies>& replies);

/// Shows the answer to an order to a person: for each reply a table of the objects and one sentence
/// about the outcome, in whole lines. `replies` has one entry for each command of the order; the
/// vocabulary gives values their words and units. A reply that asks for an unlocked device comes
/// first, in whatever order the replies came.
///
///     OBJECT        ROOM         HOME         POWER  OUTCOME
///     Floor Lamp    Living Room  Beach House  on     ok
///     Garage Light  Garage       Beach House         unreachable
///     1 light set, 1 unreachable: Garage Light
[[nodiscard]] std::string answerText(const Order& order, const std::vector<Replies>& replies,
                                     const Vocabulary& vocabulary, const TerminalStyle& style);

}  // namespace nidus
