#pragma once

#include <filesystem>
#include <functional>
#include <memory>
#include <string>
#include <thread>

#include "HomePlatform/Result.h"
#include "HomePlatform/System/FileDescriptor.h"

namespace nidus {

/// Tells, on a thread of its own, when a file of a folder has been written, replaced or removed.
///
///     auto watch = FolderWatch::start(folder, "preferences.json", [] { … });
class FolderWatch {
 public:
  /// Starts to watch the file `name` in `folder`. `onChange` is called once at the start, for what
  /// has changed before, and after each change; never empty.
  [[nodiscard]] static Result<std::unique_ptr<FolderWatch>> start(
      const std::filesystem::path& folder, std::string name, std::function<void()> onChange);
  /// Ends the thread; to be called on another one.
  ~FolderWatch();
  FolderWatch(const FolderWatch&) = delete;
  FolderWatch& operator=(const FolderWatch&) = delete;

 private:
  FolderWatch(FileDescriptor events, FileDescriptor stop, std::string name,
              std::function<void()> onChange);

  void run();
  [[nodiscard]] bool waitForEvents() const;
  [[nodiscard]] bool readEvents() const;

  const FileDescriptor events_;
  const FileDescriptor stop_;
  const std::string name_;
  const std::function<void()> onChange_;
  std::thread thread_;
};

}  // namespace nidus
