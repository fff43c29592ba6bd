#pragma once

#include <memory>
#include <vector>

#include "HomePlatform/Result.h"
#include "PlatformModel/Assistant/NDAssistantModule.h"
#include "PlatformModel/Assistant/VAHAEntity.h"
#include "PlatformModel/System/NDDictionary.h"
#include "PlatformModel/System/NDString.h"

namespace nidus {

/// The answer to one request for a change.
struct SyncChange {
  NDString after;                            ///< The anchor asked with; may be null.
  std::shared_ptr<const VAHAEntity> object;  ///< Null at the end of the data.
  NDString postAnchor;                       ///< May be null.
};

/// The assistant's side of a sync: begins it, pulls the changes and ends it.
///
/// Used by one thread at a time.
///
///     auto client = SyncClient::make(*module);
///     (*client)->begin(kSyncKey);
///     for (const SyncChange& change : (*client)->allChanges()) print(change);
///     (*client)->end();
class SyncClient {
 public:
  /// Makes a client with a sync handler of its own; never null. Fails, as the platform's fault,
  /// when the module makes no handler.
  [[nodiscard]] static Result<std::shared_ptr<SyncClient>> make(const NDAssistantModule& module);

  /// Begins a sync and blocks until the plug-in has its data, for about two seconds at most.
  /// A key that the plug-in does not know stops the process. `anchor` and `validity` may be null.
  void begin(const NDString& key, const NDString& anchor = nullptr,
             const NDString& validity = nullptr);
  /// Asks for the change that follows `anchor`, which may be null.
  [[nodiscard]] SyncChange changeAfter(const NDString& anchor);
  /// Asks for one change after the other, from no anchor to the end marker, which is the last.
  [[nodiscard]] std::vector<SyncChange> allChanges();
  void end();

  /// The validities of the resets so far, null ones included, in order. One may come late.
  [[nodiscard]] std::vector<NDString> resets() const;

 private:
  class BeginInfo;
  explicit SyncClient(std::shared_ptr<AFSyncHandler> handler);

  const std::shared_ptr<AFSyncHandler> handler_;
  const std::shared_ptr<BeginInfo> beginInfo_;
};

/// The key under which the plug-in serves the names of the home.
inline constexpr const char kSyncKey[] = "com.corvane.nidus.name";

/// The dictionary form of an entity, null for null.
[[nodiscard]] NDDictionaryValue entityValue(const std::shared_ptr<const VAHAEntity>& entity);

}  // namespace nidus
