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

std::filesystem::path userFolder(const char* variable, const char* belowHome) {
  // A relative one is to be ignored.
  if (auto folder = environment(variable); folder.is_absolute()) return folder / "nidus";
  const auto home = environment("HOME");
  return home.empty() ? home : home / belowHome / "nidus";
}

Result<std::filesystem::path> dataFolderOf(const Settings& settings) {
  if (!settings.dataFolder.empty()) return std::filesystem::path(settings.dataFolder);
  if (auto folder = environment("NIDUS_DATA"); !folder.empty()) return folder;
  if (auto folder = userFolder("XDG_DATA_HOME", ".local/share"); !folder.empty()) return folder;
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
