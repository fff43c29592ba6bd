#pragma once

#include <string>

#include "nidus/Answers/ReplyForm.h"
#include "nidus/Orders/Order.h"

namespace nidus {

/// Says in one sentence what became of an order, such as "3 lights set, 1 unreachable: Café Lamp".
[[nodiscard]] std::string outcomeSentence(const Order& order, const ReplyForm& reply,
                                          const Vocabulary& vocabulary);

/// Whether a reply asks for an unlocked device.
[[nodiscard]] bool requiresUnlock(const ReplyForm& reply);

/// What is said of an order without a reply, and of a reply without objects beside another reply.
inline constexpr const char kNoReplySentence[] =
    "The plug-in gave no reply; see why with nidus explain and the same words";
inline constexpr const char kNoResultsSentence[] = "No object gave a result";

/// An outcome in a word: "ok", "unreachable", "read-only", "failed".
[[nodiscard]] std::string outcomeWord(const std::string& outcome);

}  // namespace nidus
