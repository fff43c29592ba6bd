#include "HomePlatform/System/FilePlacing.h"

#include <fcntl.h>
#include <unistd.h>

#include <cerrno>
#include <cstdio>

#include "HomePlatform/System/FileDescriptor.h"

namespace nidus {

int putInPlace(const std::filesystem::path& temporary, const std::filesystem::path& file) {
  const FileDescriptor opened(::open(temporary.c_str(), O_RDONLY | O_CLOEXEC));
  if (!opened || ::fsync(opened.get()) != 0) return errno;
  if (::rename(temporary.c_str(), file.c_str()) != 0) return errno;
  syncFolder(file.parent_path());
  return 0;
}

void syncFolder(const std::filesystem::path& folder) {
  const char* path = folder.empty() ? "." : folder.c_str();
  const FileDescriptor opened(::open(path, O_RDONLY | O_DIRECTORY | O_CLOEXEC));
  if (opened) ::fsync(opened.get());
}

}  // namespace nidus
