#pragma once

#include <atomic>
#include <cstdint>
#include <filesystem>
#include <functional>
#include <memory>
#include <optional>
#include <utility>
#include <vector>

#include "HomePlatform/Result.h"
#include "HomePlatform/Store/HomeData.h"
#include "HomePlatform/Store/HomeStore.h"
#include "HomePlatform/System/FolderWatch.h"

namespace nidus {

/// Tells what the homes of a database are after each change, whoever makes it: this process or
/// another one.
///
/// Has a connection and a thread of its own, and polls nothing.
///
///     auto watch = HomeWatch::start(folder / kDatabaseFile, [](auto homes) { … });
class HomeWatch {
 public:
  /// Takes the homes, or the failure that has ended the watch.
  using Handler = std::function<void(Result<std::vector<HomeData>>)>;

  /// Starts to watch. `handler`, which is never empty, is called on the watch's thread: once with
  /// the homes as they are at the start, then after each change of the database. Changes that
  /// follow each other closely may come as one. No change after the first call is missed. After a
  /// failure, such as a database that has been removed, it is not called any more.
  [[nodiscard]] static Result<std::unique_ptr<HomeWatch>> start(std::filesystem::path file,
                                                                Handler handler);
  /// Waits for a call that is running; to be called on another thread.
  ~HomeWatch();
  HomeWatch(const HomeWatch&) = delete;
  HomeWatch& operator=(const HomeWatch&) = delete;

 private:
  /// What tells one file from another that takes its place.
  using Identity = std::pair<std::uint64_t, std::uint64_t>;

  HomeWatch(std::filesystem::path file, Handler handler)
      : file_(std::move(file)), handler_(std::move(handler)) {}

  void look();
  [[nodiscard]] Status tellChange();
  [[nodiscard]] Status openStore();
  [[nodiscard]] Status waitForWriter();
  [[nodiscard]] std::optional<Identity> identity() const;

  const std::filesystem::path file_;
  const Handler handler_;
  std::atomic<bool> isStopping_{false};
  // What follows belongs to the thread of the watch.
  std::unique_ptr<HomeStore> store_;
  std::optional<Identity> opened_;  ///< The file that `store_` has open.
  std::optional<std::uint64_t> toldVersion_;
  bool hasFailed_ = false;
  std::unique_ptr<FolderWatch> watch_;  ///< Last: its thread uses all the others.
};

}  // namespace nidus
