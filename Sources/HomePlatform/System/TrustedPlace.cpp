#include "HomePlatform/System/TrustedPlace.h"

#include <sys/stat.h>
#include <unistd.h>

#include <deque>
#include <string>
#include <system_error>

#include "HomePlatform/System/ShellWord.h"

namespace nidus {
namespace {

namespace fs = std::filesystem;

constexpr mode_t kWritableByOthers = S_IWGRP | S_IWOTH;

/// Whoever owns the program decides anyway what it does.
uid_t ownerOfProgram() {
  struct stat status = {};
  return ::stat("/proc/self/exe", &status) == 0 ? status.st_uid : 0;
}

bool isOfOthers(const struct stat& status) {
  static const uid_t kOwnerOfProgram = ownerOfProgram();
  return status.st_uid != 0 && status.st_uid != ::geteuid() && status.st_uid != kOwnerOfProgram;
}

Failure othersOwn(const fs::path& place) {
  return {Failure::Kind::platform,
          place.string() + ": it belongs to another user, who decides with it what the assistant " +
              "does; sudo chown \"$(id -un)\" " + shellWord(place.string())};
}

Failure othersMayWrite(const fs::path& place) {
  return {Failure::Kind::platform,
          place.string() + ": others may change it, and with it what the assistant does; " +
              "chmod go-w " + shellWord(place.string())};
}

Status checkPlace(const fs::path& place, const struct stat& status) {
  if (isOfOthers(status)) return othersOwn(place);
  if ((status.st_mode & kWritableByOthers) != 0) return othersMayWrite(place);
  return std::nullopt;
}

/// A folder through which the way leads.
Status checkPassage(const fs::path& place, const struct stat& status) {
  if (!isOfOthers(status) && (status.st_mode & S_ISVTX) != 0) return std::nullopt;
  return checkPlace(place, status);
}

/// The way to a place, gone step by step.
class Way {
 public:
  explicit Way(const fs::path& path) { goOn(path); }

  Status check() {
    struct stat status = {};
    while (::lstat(at_.c_str(), &status) == 0) {
      Status failure = S_ISLNK(status.st_mode) ? follow(status) : stay(status);
      if (failure || ahead_.empty()) return failure;
      advance();
    }
    return std::nullopt;  // who wants to use what is missing or out of reach is told then
  }

 private:
  static constexpr int kMostLinks = 40;  ///< As the system has it: more of them lead nowhere.

  void goOn(const fs::path& path) {
    const fs::path parts = path.relative_path();
    ahead_.insert(ahead_.begin(), parts.begin(), parts.end());
    if (path.is_absolute()) at_ = "/";
  }

  void advance() {
    at_ /= ahead_.front();
    ahead_.pop_front();
  }

  [[nodiscard]] Status stay(const struct stat& status) const {
    return ahead_.empty() ? checkPlace(at_, status) : checkPassage(at_, status);
  }

  /// The permissions of a link mean nothing, but its owner may exchange it.
  Status follow(const struct stat& status) {
    if (isOfOthers(status)) return othersOwn(at_);
    std::error_code error;
    const fs::path target = fs::read_symlink(at_, error);
    at_ = at_.parent_path();
    if (!error && ++links_ <= kMostLinks) goOn(target);
    return std::nullopt;
  }

  fs::path at_;
  std::deque<fs::path> ahead_;
  int links_ = 0;
};

}  // namespace

Status checkTrusted(const fs::path& path) {
  struct stat status = {};
  if (::lstat(path.c_str(), &status) != 0) return std::nullopt;
  return S_ISLNK(status.st_mode) ? checkTrustedWay(path) : checkPlace(path, status);
}

Status checkTrustedWay(const fs::path& path) {
  std::error_code error;
  const fs::path whole = fs::absolute(path, error);
  if (error) return std::nullopt;
  return Way(whole).check();
}

}  // namespace nidus
