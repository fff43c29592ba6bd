#include "nidus/FileReplacement.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstdlib>
#include <string>
#include <system_error>

#include "nidus/InterruptionHold.h"
#include "nidus/StandardStreams.h"

namespace nidus {
namespace {

/// An open file, closed at the end.
class OpenFile {
 public:
  explicit OpenFile(int number) : number_(number) {}
  OpenFile(const OpenFile&) = delete;
  OpenFile& operator=(const OpenFile&) = delete;
  ~OpenFile() {
    if (number_ >= 0) close(number_);
  }
  [[nodiscard]] bool isOpen() const { return number_ >= 0; }
  [[nodiscard]] int number() const { return number_; }

 private:
  const int number_;
};

Status writeThrough(const std::filesystem::path& file, std::string_view text) {
  const OpenFile open(::open(file.c_str(), O_WRONLY | O_CLOEXEC));
  if (!open.isOpen() || !writeWhole(open.number(), text)) return unwritable(file, errno);
  return std::nullopt;
}

/// The permissions that the new content is to have.
mode_t permissionsFor(const std::filesystem::path& file) {
  struct stat old = {};
  if (stat(file.c_str(), &old) == 0) return old.st_mode & 07777U;
  const mode_t mask = umask(0);
  umask(mask);
  return 0666U & ~mask;
}

Status replaceOrdinary(const std::filesystem::path& file, std::string_view text) {
  const InterruptionHold hold;  // nothing is left beside the file
  std::string temporary = file.string() + ".XXXXXX";
  const OpenFile open(mkostemp(temporary.data(), O_CLOEXEC));
  if (!open.isOpen()) return unwritable(file, errno);
  if (writeWhole(open.number(), text) && fchmod(open.number(), permissionsFor(file)) == 0 &&
      fsync(open.number()) == 0 && rename(temporary.c_str(), file.c_str()) == 0) {
    return std::nullopt;
  }
  const int error = errno;
  unlink(temporary.c_str());
  return unwritable(file, error);
}

}  // namespace

Status replaceFile(const std::filesystem::path& file, std::string_view text) {
  namespace fs = std::filesystem;
  std::error_code error;
  const fs::file_status status = fs::status(file, error);
  if (fs::is_directory(status)) return unwritable(file, EISDIR);
  if (fs::exists(status) && !fs::is_regular_file(status)) return writeThrough(file, text);
  const fs::path target = fs::weakly_canonical(file, error);
  return replaceOrdinary(error ? file : target, text);
}

Failure unwritable(const std::filesystem::path& file, int error) {
  return {Failure::Kind::platform, file.string() + ": cannot be written (" +
                                       std::generic_category().message(error) +
                                       "); choose a writable place with room"};
}

}  // namespace nidus
