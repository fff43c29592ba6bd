#pragma once

#include <functional>
#include <string>
#include <vector>

#include "HomePlatform/Metadata/Vocabulary.h"
#include "HomePlatform/Result.h"
#include "HomePlatform/Store/HomeData.h"
#include "nidus/ExitStatus.h"

namespace nidus {

class Workspace;

/// Changes homes and gives what was done, in a sentence without its end; or fails.
using HomeChange =
    std::function<Result<std::string>(std::vector<HomeData>& homes, const Vocabulary& vocabulary)>;

/// Makes a change of the homes in the database, whole or not at all, and prints what was done.
[[nodiscard]] ExitStatus changeHomes(Workspace& workspace, const HomeChange& change);

}  // namespace nidus
