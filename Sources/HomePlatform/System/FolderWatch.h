#pragma once

#include <filesystem>
#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <thread>
#include <vector>

#include "HomePlatform/Result.h"
#include "HomePlatform/System/FileDescriptor.h"

namespace nidus {

/// The files of a folder that are watched.
struct WatchedFiles {
  std::vector<std::string> names;
  /// Whether each write counts, or a file only when it is closed after it was written: what is kept
  /// open, such as the log of a database, is never closed; what is not, is whole by then.
  bool eachWrite = false;
};

/// Tells, on a thread of its own, when a file of a folder has been written, replaced or removed, or
/// the folder has.
///
///     auto watch = FolderWatch::start(folder, {{"preferences.json"}}, [] { … });
class FolderWatch {
 public:
  /// Starts to watch `files` in `folder`. `onChange` is called once at the start, for what has
  /// changed before, and after each change, or several; never empty.
  [[nodiscard]] static Result<std::unique_ptr<FolderWatch>> start(
      const std::filesystem::path& folder, WatchedFiles files, std::function<void()> onChange);
  /// Ends the thread; to be called on another one.
  ~FolderWatch();
  FolderWatch(const FolderWatch&) = delete;
  FolderWatch& operator=(const FolderWatch&) = delete;

 private:
  FolderWatch(FileDescriptor events, FileDescriptor stop, std::vector<std::string> names,
              std::function<void()> onChange);

  void run();
  [[nodiscard]] bool waitForEvents() const;
  [[nodiscard]] bool readEvents() const;
  [[nodiscard]] bool isWatched(std::string_view name) const;

  const FileDescriptor events_;
  const FileDescriptor stop_;
  const std::vector<std::string> names_;
  const std::function<void()> onChange_;
  std::thread thread_;
};

}  // namespace nidus
