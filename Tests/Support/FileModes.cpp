#include "Support/FileModes.h"

#include <sys/stat.h>

namespace nidus {

mode_t permissionsOf(const std::filesystem::path& path) {
  constexpr mode_t kPermissions = 0777;
  struct stat status = {};
  return ::stat(path.c_str(), &status) == 0 ? status.st_mode & kPermissions : 0;
}

FileCreationMask::FileCreationMask(mode_t mask) : before_(::umask(mask)) {}

FileCreationMask::~FileCreationMask() { ::umask(before_); }

}  // namespace nidus
