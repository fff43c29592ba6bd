#pragma once

#include <filesystem>
#include <functional>
#include <map>
#include <memory>
#include <optional>
#include <string>

#include "HomePlatform/Json/JsonValue.h"
#include "HomePlatform/Result.h"
#include "HomePlatform/System/PreferencesFile.h"
#include "PlatformModel/System/NDMutex.h"
#include "PlatformModel/System/NDPreferences.h"
#include "PlatformModel/System/NDValue.h"

namespace nidus {

/// The preferences of one platform, in a file or in memory. May be used from any thread.
///
/// What is not of the type that a reader asks for is, for that reader, not valid. When the file
/// becomes unreadable, the values read last stay, and that is said once for each such state of it.
class Preferences final : public NDPreferences {
 public:
  /// The domain whose booleans these preferences hold.
  static constexpr const char* kDomain = "com.corvane.nidusd";
  /// Whether there are homes that the assistant may see.
  static constexpr const char* kHomesConfigured = "kHomesConfigured";
  /// Of the file in its folder.
  static constexpr const char* kFileName = "preferences.json";

  /// Opens those of a file in `folder`; fails when it is damaged. `reportFailure` hears of a file
  /// that is damaged later; never empty.
  [[nodiscard]] static Result<std::shared_ptr<Preferences>> open(
      const std::filesystem::path& folder, std::function<void(const Failure&)> reportFailure);
  /// Makes those of a platform in memory, whose container is `containerPath`.
  [[nodiscard]] static std::shared_ptr<Preferences> inMemory(
      const std::map<std::string, JsonValue>& values, std::string containerPath);

  [[nodiscard]] BooleanReading booleanForKey_domain_container(
      const NDString& key, const NDString& domain, const NDString& containerPath) override;
  void synchronize() override;
  [[nodiscard]] std::int64_t integerForKey(const NDString& key) override;

  /// The value of `key` as a boxed value; null when it is missing or nothing that can be boxed.
  [[nodiscard]] NDValueRef valueForKey(const std::string& key);

  /// All values as they were read last.
  [[nodiscard]] std::map<std::string, JsonValue> values();

  /// The container whose preferences these are: the folder of the file.
  [[nodiscard]] const std::string& containerPath() const { return containerPath_; }

  /// Says why the file cannot be changed: because it is damaged, or cannot be read.
  [[nodiscard]] Status check() { return read(); }

  /// Sets or, with null, removes keys; the others stay as they are in the file now.
  [[nodiscard]] Status change(const std::map<std::string, JsonValue>& changes);

  /// Says whether the file has been found changed since it was opened or since the last call.
  [[nodiscard]] bool takeChange();

 private:
  Preferences(std::optional<PreferencesFile> file, std::string containerPath,
              std::function<void(const Failure&)> reportFailure);

  [[nodiscard]] Status read();
  void readIfStamped();
  [[nodiscard]] const JsonValue* find(std::string_view key) const ND_REQUIRES(mutex_);
  void reportOnce(const Failure& failure, const std::string& stamp);

  const std::optional<PreferencesFile> file_;
  const std::string containerPath_;
  const std::function<void(const Failure&)> reportFailure_;
  NDMutex fileMutex_;  ///< Held while the file is read or replaced, so that no older state wins.
  NDMutex mutex_;
  PreferencesContent content_ ND_GUARDED_BY(mutex_);
  std::string stamp_ ND_GUARDED_BY(mutex_);          ///< Of the file when it was read last.
  std::string takenText_ ND_GUARDED_BY(mutex_);      ///< The text at the last `takeChange`.
  std::string reportedStamp_ ND_GUARDED_BY(mutex_);  ///< Of the damaged file reported last.
};

}  // namespace nidus
