#include "nidus/Settings.h"

#include <cstdlib>

namespace nidus {
namespace {

/// The value of an environment variable; empty when it is not set.
std::filesystem::path environment(const char* name) {
  const char* value = std::getenv(name);
  return value ? value : "";
}

}  // namespace

Result<std::filesystem::path> dataFolderOf(const Settings& settings) {
  if (!settings.dataFolder.empty()) return std::filesystem::path(settings.dataFolder);
  if (auto folder = environment("NIDUS_DATA"); !folder.empty()) return folder;
  // A relative one is to be ignored.
  if (auto folder = environment("XDG_DATA_HOME"); folder.is_absolute()) return folder / "nidus";
  if (auto folder = environment("HOME"); !folder.empty()) {
    return folder / ".local" / "share" / "nidus";
  }
  return Failure{Failure::Kind::badInput,
                 "no data folder is known; give --data DIR or set NIDUS_DATA or HOME"};
}

Result<HomePlatformOptions> platformOptionsOf(const Settings& settings) {
  auto folder = dataFolderOf(settings);
  if (!folder) return folder.failure();
  HomePlatformOptions options;
  options.dataFolder = *folder;
  options.locked = settings.isLocked;
  return options;
}

}  // namespace nidus
