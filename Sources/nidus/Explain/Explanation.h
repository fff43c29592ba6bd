#pragma once

#include <string>
#include <vector>

#include "nidus/Explain/Rehearsal.h"
#include "nidus/Orders/Order.h"
#include "nidus/Terminal/Terminal.h"

namespace nidus {

/// An order and what was seen while its commands were rehearsed.
struct Explanation {
  Order order;
  std::vector<Rehearsal> rehearsals;  ///< One for each command of the order.
};

/// The order of somebody who gave `command` itself.
[[nodiscard]] Order orderOf(CommandRef command);

/// Rehearses all commands of `order`.
[[nodiscard]] Result<Explanation> explain(Order order, RehearsalStage& stage);

/// An explanation for people, in sections.
[[nodiscard]] std::string explanationText(const Explanation& explanation,
                                          const RehearsalStage& stage, const TerminalStyle& style);

/// An explanation as JSON, a line for each command of the order: "filter", a list of "step" and
/// "kept"; "reached"; "platform", the calls; "changes", the values that would be others; "log";
/// "replies".
[[nodiscard]] std::string explanationJson(const Explanation& explanation,
                                          const RehearsalStage& stage);

}  // namespace nidus
