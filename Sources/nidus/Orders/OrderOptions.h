#pragma once

#include "nidus/CommandSyntax.h"
#include "nidus/Orders/Order.h"

namespace nidus {

/// Declares an option for each field of the filter; `filter` must live as long as what runs.
void declareFilterOptions(CommandSyntax& syntax, OrderFilter& filter);

}  // namespace nidus
