#pragma once

#include <vector>

#include "HomePlatform/Result.h"
#include "nidus/Answers/Answer.h"
#include "nidus/ExitStatus.h"
#include "nidus/Orders/Order.h"
#include "nidus/Session.h"

namespace nidus {

/// Turns a person's words into an order for the homes of `session`, and opens its module. Nothing
/// is changed; for a minimum or maximum the plug-in is asked for the limits.
[[nodiscard]] Result<Order> readOrderFor(Session& session, const OrderWords& words);

/// Has the plug-in do `order`: the replies to each of its commands. The module
/// is open.
[[nodiscard]] Result<std::vector<Replies>> performOrder(Session& session, const Order& order);

/// The exit status of an order: the highest of its commands. An object need not have all limits, so
/// that one of them is enough for `limits`.
[[nodiscard]] ExitStatus statusOf(const Order& order, const std::vector<Replies>& replies);

}  // namespace nidus
