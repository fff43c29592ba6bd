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

/// What a change of the homes needs to understand people.
struct HomeWording {
  const Vocabulary& vocabulary;
  bool isMetric;  ///< The metric flag of the device.
};

/// Changes homes and gives what was done, in a sentence without its end; or fails.
using ChangeOfHomes =
    std::function<Result<std::string>(std::vector<HomeData>& homes, const HomeWording& wording)>;

/// Makes a change of the homes in the database, whole or not at all, and prints what was done.
[[nodiscard]] ExitStatus changeHomes(Workspace& workspace, const ChangeOfHomes& change);

}  // namespace nidus
