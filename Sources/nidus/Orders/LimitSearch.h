#pragma once

#include "AssistantHost/CommandRunner.h"
#include "HomePlatform/Result.h"
#include "nidus/Orders/Order.h"
#include "nidus/Orders/OrderValue.h"

namespace nidus {

/// Gives the commands of an order to a minimum or maximum their values; any other order comes back
/// as it is. The plug-in writes what the assistant gave, never the limit that it found, so that the
/// limit is asked for first. Where the objects differ in it each gets a command of its own; without
/// any limit the order stays as it is, and the plug-in says so. A failure, as bad input, says that
/// objects that differ can not be told apart by name.
[[nodiscard]] Result<Order> withLimitValues(Order order, const Vocabulary& vocabulary,
                                            const OrderValueReader& values, CommandRunner& runner);

}  // namespace nidus
