#pragma once

#include <chrono>
#include <filesystem>
#include <functional>
#include <iosfwd>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "HomePlatform/Json/JsonValue.h"
#include "HomePlatform/Metadata/Vocabulary.h"
#include "HomePlatform/PlatformCall.h"
#include "HomePlatform/Result.h"
#include "HomePlatform/Store/HomeData.h"
#include "HomePlatform/Store/HomeEdit.h"
#include "HomePlatform/Store/HomeStore.h"
#include "HomePlatform/Store/HomeWatch.h"
#include "HomePlatform/Store/StoreProgress.h"
#include "PlatformModel/NDPlatform.h"

namespace nidus {

/// How a platform is opened.
struct HomePlatformOptions {
  /// Where the database, the preferences and the vocabulary are; it is made when it is missing.
  /// None keeps everything in memory and touches no file.
  std::optional<std::filesystem::path> dataFolder = std::nullopt;
  /// Whether the device is locked.
  bool locked = false;
  /// Runs all work on the thread that drains (`drain`, or a wait): no thread is started, and a wait
  /// that nothing can end is over at once, as if its time had passed.
  bool drainsOnCaller = false;
  /// The clock of all waits; null takes the machine's, or, with `drainsOnCaller`, the jumping one.
  std::shared_ptr<NDClock> clock = nullptr;
  /// How long a change waits for another process that is changing the homes.
  std::chrono::milliseconds lockTimeout = HomeStore::kLockTimeout;
  /// The metric flag; none takes it from the environment's locale.
  std::optional<bool> metric = std::nullopt;
  /// Homes of a platform in memory, as a home document may hold them.
  std::vector<HomeData> homes = {};
  /// The vocabulary of a platform in memory; none takes the built-in one.
  std::optional<Vocabulary> vocabulary = std::nullopt;
  /// Preferences of a platform in memory, "kHomesConfigured" included.
  std::map<std::string, JsonValue> preferences = {};
  /// The "InternalBuild" answer of a platform in memory.
  bool internalBuild = false;
  /// Takes each message that the log passes on, on the thread that sends it; empty sends it to
  /// standard error and, where the machine has one, to the system log.
  std::function<void(const NDSystemLogMessage&)> logSink = nullptr;
  /// Hears of each failure of the platform after it was opened, such as a database that can no
  /// longer be read: on any thread, once where it happened. What failed is answered all the same,
  /// with no homes or with errors. It must neither log through the plug-in nor call the platform.
  /// Empty writes a line to standard error.
  std::function<void(const Failure&)> failureHandler = nullptr;
  /// Hears of each call on a home, before it is answered; may be empty. On any thread.
  std::function<void(const PlatformCall&)> callObserver = nullptr;
};

/// The home platform of one machine: homes from a database, accessories behind drivers.
///
/// Opened by the host, registered by it (`NDPlatform::registerPlatform`), and shut down before the
/// process ends. May be used from any thread unless said otherwise.
///
///     auto platform = HomePlatform::open({.dataFolder = folder});
///     if (!platform) return report(platform.failure());
class HomePlatform : public NDPlatform {
 public:
  [[nodiscard]] static Result<std::shared_ptr<HomePlatform>> open(HomePlatformOptions options);
  /// Whether opening `folder` would find a home database there; looks without making anything.
  [[nodiscard]] static bool hasDatabase(const std::filesystem::path& folder);

  /// Puts `homes` into the database: in place of all (or, with `merge`, of those of the same UUID)
  /// in one transaction; afterwards sets "kHomesConfigured" to whether there are homes.
  /// `progress` may be empty.
  [[nodiscard]] virtual Status importHomes(const std::vector<HomeData>& homes, bool merge,
                                           const StoreProgress& progress = nullptr) = 0;
  /// Lets `edit` change the homes as the database has them, in one transaction: no value that
  /// anybody writes meanwhile is lost. Checks and keeps what it leaves, and sets "kHomesConfigured"
  /// as an import does; after a failure all is as it was. `edit` must be quick and must not call
  /// the platform.
  [[nodiscard]] virtual Status editHomes(const HomeEdit& edit) = 0;
  /// The homes as the database has them now.
  [[nodiscard]] virtual Result<std::vector<HomeData>> exportHomes() = 0;

  /// Watches the homes of the data folder, whoever changes them; see HomeWatch. A platform in
  /// memory cannot be watched.
  [[nodiscard]] virtual Result<std::unique_ptr<HomeWatch>> watchHomes(
      HomeWatch::Handler handler) = 0;

  /// The words that this platform knows, the user's own included; valid as long as the platform.
  [[nodiscard]] virtual const Vocabulary& vocabulary() const noexcept = 0;
  virtual void setLocked(bool locked) = 0;
  /// Managers that are created from then on never report their homes, or do again.
  virtual void setSilent(bool silent) = 0;
  /// The preferences as they were read last, whether anything reads them or not.
  [[nodiscard]] virtual std::map<std::string, JsonValue> preferenceValues() = 0;
  /// Changes preferences (null removes the key) and posts the change notification.
  [[nodiscard]] virtual Status changePreferences(
      const std::map<std::string, JsonValue>& changes) = 0;

  /// Waits until every queue of the platform is idle; runs the work of the main queue, and with
  /// `drainsOnCaller` all other work, on the calling thread. Deliveries that the calling thread
  /// holds back are let go first. Not to be called from a queue.
  virtual void drain() = 0;
  /// Ends all work and tells the delegates of managers that have not reported that they never will;
  /// a manager that is still held back, or made later, tells it when its hold is released. Work and
  /// completions that were waiting are destroyed without being run; running work is waited for.
  /// The threads end. Afterwards homes can still be looked at, but their calls are not answered.
  /// Further calls do nothing; so does the destructor, which shuts down too.
  virtual void shutDown() = 0;
};

}  // namespace nidus
