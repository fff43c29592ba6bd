#pragma once

#include <string>

#include "HomePlatform/Result.h"
#include "HomePlatform/Store/Database.h"
#include "HomePlatform/Store/Schema.h"

namespace nidus {

/// What people see when the database `name` fails: the file, what is wrong with it and the remedy.
[[nodiscard]] Failure failureOf(const DatabaseError& error, const std::string& name);
[[nodiscard]] Failure failureOf(SchemaProblem problem, const std::string& name);

}  // namespace nidus
