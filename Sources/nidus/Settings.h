#pragma once

#include <filesystem>
#include <string>

#include "HomePlatform/HomePlatform.h"
#include "HomePlatform/Result.h"

namespace nidus {

/// What was asked for on the command line, whatever the command.
struct Settings {
  std::string dataFolder;  ///< Empty: not given.
  bool isLocked = false;
};

/// The data folder: the given one, else that of the environment variable NIDUS_DATA, else `nidus`
/// in the user's data folder. A failure, as bad input, says that none of them is set.
[[nodiscard]] Result<std::filesystem::path> dataFolderOf(const Settings& settings);

/// The program's folder for one kind of the user's files: below the folder that the environment
/// variable names, else below `belowHome` in the home folder; empty when neither is known.
[[nodiscard]] std::filesystem::path userFolder(const char* variable, const char* belowHome);

/// How to open the platform that `settings` ask for.
[[nodiscard]] Result<HomePlatformOptions> platformOptionsOf(const Settings& settings);

}  // namespace nidus
