#include "HomePlatform/Store/HomeWatch.h"

#include <sys/stat.h>

#include <chrono>
#include <string>

namespace nidus {
namespace {

/// How long one wait for a writer lasts, and with it the end of the watch at the most.
constexpr std::chrono::milliseconds kTurn{1000};

}  // namespace

Result<std::unique_ptr<HomeWatch>> HomeWatch::start(std::filesystem::path file, Handler handler) {
  std::unique_ptr<HomeWatch> watch(new HomeWatch(std::move(file), std::move(handler)));
  const std::string name = watch->file_.filename().string();
  // A commit is a write to the log. The file itself counts for being replaced or removed.
  auto started = FolderWatch::start(watch->file_.parent_path(), {{name, name + "-wal"}, true},
                                    [raw = watch.get()] { raw->look(); });
  if (!started) return started.failure();
  watch->watch_ = std::move(*started);
  return watch;
}

HomeWatch::~HomeWatch() {
  isStopping_.store(true);
  watch_.reset();
}

void HomeWatch::look() {
  if (hasFailed_ || isStopping_.load()) return;
  if (Status failure = tellChange()) {
    hasFailed_ = true;
    handler_(*failure);
  }
}

Status HomeWatch::tellChange() {
  if (Status failure = openStore()) return failure;
  if (Status failure = waitForWriter()) return failure;
  if (isStopping_.load()) return std::nullopt;
  const auto version = store_->version();
  if (!version) return version.failure();
  if (toldVersion_ == *version) return std::nullopt;
  auto homes = store_->loadHomes();
  if (!homes) return homes.failure();
  toldVersion_ = *version;
  handler_(std::move(homes));
  return std::nullopt;
}

/// Opens the database, at the start and when another file has taken its place.
Status HomeWatch::openStore() {
  const auto present = identity();
  if (!present) {
    return Failure{Failure::Kind::platform, file_.string() +
                                                ": the database is gone; restore it, or import "
                                                "the homes again"};
  }
  if (present == opened_) return std::nullopt;
  auto store = HomeStore::open(file_, kTurn);
  if (!store) return store.failure();
  store_ = std::move(*store);
  opened_ = present;
  toldVersion_.reset();
  return std::nullopt;
}

/// A write to the log comes before its commit can be seen, and nothing tells of that moment; so the
/// writer is waited for.
Status HomeWatch::waitForWriter() {
  while (!isStopping_.load()) {
    const auto isDone = store_->waitForWriter();
    if (!isDone) return isDone.failure();
    if (*isDone) return std::nullopt;
  }
  return std::nullopt;
}

std::optional<HomeWatch::Identity> HomeWatch::identity() const {
  struct stat status = {};
  if (::stat(file_.c_str(), &status) != 0) return std::nullopt;
  return Identity{status.st_dev, status.st_ino};
}

}  // namespace nidus
