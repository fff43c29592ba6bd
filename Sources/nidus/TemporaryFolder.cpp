#include "nidus/TemporaryFolder.h"

#include <cerrno>
#include <cstdlib>
#include <string>
#include <system_error>

#include "HomePlatform/System/TrustedPlace.h"

namespace nidus {

Result<TemporaryFolder> TemporaryFolder::make() {
  std::error_code error;
  const auto parent = std::filesystem::temp_directory_path(error);
  std::string name = (parent / "nidus-XXXXXX").string();
  if (error || !mkdtemp(name.data())) {
    const auto reason = error ? error.message() : std::generic_category().message(errno);
    return Failure{Failure::Kind::platform,
                   name + ": cannot be made (" + reason + "); set TMPDIR to a writable folder"};
  }
  TemporaryFolder made(name);
  if (Status failure = checkTrustedWay(name)) return *failure;
  return made;
}

TemporaryFolder::~TemporaryFolder() {
  std::error_code ignored;
  if (!path_.empty() && !isKept_) std::filesystem::remove_all(path_, ignored);
}

}  // namespace nidus
