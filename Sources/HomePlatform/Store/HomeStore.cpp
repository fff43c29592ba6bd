#include "HomePlatform/Store/HomeStore.h"

#include "HomePlatform/Store/Database.h"
#include "HomePlatform/Store/DatabaseFile.h"
#include "HomePlatform/Store/FileHomeStore.h"
#include "HomePlatform/Store/MemoryHomeStore.h"
#include "HomePlatform/Store/StoreFailures.h"
#include "HomePlatform/System/DataFolder.h"

namespace nidus {
namespace {

using OpenedStore = Result<std::unique_ptr<HomeStore>>;

OpenedStore openInMemory() {
  try {
    return std::unique_ptr<HomeStore>(std::make_unique<MemoryHomeStore>());
  } catch (const DatabaseError& error) {
    return failureInMemory(error);
  }
}

OpenedStore openFile(const std::filesystem::path& file, std::chrono::milliseconds lockTimeout) {
  try {
    auto store = std::make_unique<FileHomeStore>(file, lockTimeout);
    if (Status failed = store->prepare()) return *failed;
    return std::unique_ptr<HomeStore>(std::move(store));
  } catch (const DatabaseError& error) {
    return failureOf(error, file);
  }
}

}  // namespace

OpenedStore HomeStore::open(const std::optional<std::filesystem::path>& file,
                            std::chrono::milliseconds lockTimeout) {
  if (!file) return openInMemory();
  if (Status failed = prepareDatabaseFile(*file)) return *failed;
  // One process at a time makes or migrates the databases of a folder.
  const auto folder = file->parent_path();
  const Result<FolderLock> lock = FolderLock::take(folder.empty() ? "." : folder);
  if (!lock) return lock.failure();
  return openFile(*file, lockTimeout);
}

}  // namespace nidus
