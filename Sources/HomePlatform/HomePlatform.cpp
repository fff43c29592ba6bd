#include "HomePlatform/HomePlatform.h"

#include <iostream>
#include <system_error>
#include <utility>

#include "HomePlatform/LocalHomePlatform.h"
#include "HomePlatform/Metadata/VocabularyReader.h"
#include "HomePlatform/System/DataFolder.h"

namespace nidus {
namespace {

constexpr const char* kMemoryContainer = "memory";

/// The file of that name in the data folder; none for a platform in memory.
std::optional<std::filesystem::path> fileOf(const HomePlatformOptions& options, const char* name) {
  if (!options.dataFolder) return std::nullopt;
  return *options.dataFolder / name;
}

void fillIn(HomePlatformOptions& options) {
  if (!options.logSink) options.logSink = makeMachineLogSink();
  if (!options.failureHandler) {
    options.failureHandler = [](const Failure& failure) {
      std::cerr << "nidus: " + failure.message + '\n' << std::flush;
    };
  }
}

Result<Vocabulary> openVocabulary(HomePlatformOptions& options) {
  if (!options.dataFolder && options.vocabulary) return std::move(*options.vocabulary);
  return loadVocabulary(fileOf(options, kVocabularyFile));
}

Result<std::shared_ptr<HomeStore>> openStore(HomePlatformOptions& options) {
  auto store = HomeStore::open(fileOf(options, kDatabaseFile), options.lockTimeout);
  if (!store) return store.failure();
  const auto homes = std::exchange(options.homes, {});
  if (!options.dataFolder && !homes.empty()) {
    if (Status failure = (*store)->replaceHomes(homes)) return *failure;
  }
  return std::shared_ptr<HomeStore>(std::move(*store));
}

Result<std::shared_ptr<Preferences>> openPreferences(const HomePlatformOptions& options) {
  if (options.dataFolder) return Preferences::open(*options.dataFolder, options.failureHandler);
  return Preferences::inMemory(options.preferences, kMemoryContainer);
}

}  // namespace

Result<std::shared_ptr<HomePlatform>> HomePlatform::open(HomePlatformOptions options) {
  fillIn(options);
  if (options.dataFolder) {
    if (Status failure = prepareDataFolder(*options.dataFolder)) return *failure;
  }
  auto vocabulary = openVocabulary(options);
  if (!vocabulary) return vocabulary.failure();
  auto preferences = openPreferences(options);
  if (!preferences) return preferences.failure();
  auto store = openStore(options);
  if (!store) return store.failure();
  LocalHomePlatform::Parts parts{std::move(*preferences),
                                 std::make_shared<MetadataMapper>(std::move(*vocabulary)),
                                 std::move(*store)};
  return std::shared_ptr<HomePlatform>(
      std::make_shared<LocalHomePlatform>(std::move(options), std::move(parts)));
}

bool HomePlatform::hasDatabase(const std::filesystem::path& folder) {
  std::error_code ignored;
  return std::filesystem::exists(folder / kDatabaseFile, ignored);
}

}  // namespace nidus
