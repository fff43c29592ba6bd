#pragma once

#include <string>

#include "nidus/Orders/Order.h"

namespace nidus {

/// An order as a person types it: `set power on --room Kitchen --target`, names of one word.
[[nodiscard]] OrderWords orderWords(const std::string& line);

/// The action of each command of what `line` is read as, such as "SET POWER true", a float as
/// "float 40" and units last; several with "; " between them. The message when it is refused.
[[nodiscard]] std::string actionsOf(const std::string& line, bool isMetric = true);
/// The same in the words of `vocabulary`, on a metric device.
[[nodiscard]] std::string actionsOf(const std::string& line, const Vocabulary& vocabulary);

/// The filter of what `line` is read as, such as "room=Kitchen entity=SERVICE"; the message when
/// it is refused.
[[nodiscard]] std::string filterOf(const std::string& line);

}  // namespace nidus
