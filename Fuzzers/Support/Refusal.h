#pragma once

#include <string>

#include "HomePlatform/Result.h"

namespace nidus {

/// Checks what every refusal of a document owes to people: it is bad input, names the document,
/// says something, and is one line of limited length in UTF-8 without control characters. `name` is
/// the document's; a finding ends the process.
void checkRefusal(const Failure& failure, const std::string& name,
                  Failure::Kind kind = Failure::Kind::badInput);

}  // namespace nidus
