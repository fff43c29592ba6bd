#pragma once

#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "PlatformModel/Assistant/AFServiceCommand.h"
#include "PlatformModel/Assistant/AFSyncHandler.h"
#include "PlatformModel/Assistant/NDLogThreshold.h"
#include "PlatformModel/Assistant/VAHACommand.h"
#include "PlatformModel/Home/NDCharacteristic.h"
#include "PlatformModel/System/NDDictionary.h"

namespace nidus {

/// Watches what a command does. Implemented by the host; called on the threads of the command, in
/// order, before the reply. Without an observer nothing is prepared for it.
class ND_EXPORT NDAssistantCommandObserver {
 public:
  virtual ~NDAssistantCommandObserver();
  /// A step of the filter has run: `step` names it ("snapshot", "home", "entityType",
  /// "serviceType", "room and zone", "group", "serviceName", "sceneName", "attribute"), `kept` are
  /// the records that it left, in dictionary form.
  virtual void filterDidRunStep(std::string_view step, const NDDictionaryList& kept) = 0;
  /// The action reaches these characteristics; none is null.
  virtual void actionDidReach(const std::vector<std::shared_ptr<NDCharacteristic>>& reached) = 0;
};

/// The version of everything that crosses the border between a host and the module. It grows with
/// each change of `PlatformModel` or of the struct below.
inline constexpr std::uint32_t kNDAssistantModuleInterfaceVersion = 3;

#define ND_TEXT_OF(x) #x
#define ND_TEXT(x) ND_TEXT_OF(x)
/// The C++ ABI of the compiler and of the standard library that a binary was built with.
inline constexpr const char kNDAssistantModuleABI[] =
    "c++abi-" ND_TEXT(__GXX_ABI_VERSION) "/libstdc++-" ND_TEXT(_GLIBCXX_RELEASE) "/string-" ND_TEXT(
        _GLIBCXX_USE_CXX11_ABI);
#undef ND_TEXT
#undef ND_TEXT_OF

/// What the module offers. The first two members keep their place for ever; a host reads them
/// before it touches anything else. None of its operations throws; all may be called from
/// any thread. What they make reports failures as outcomes; running out of memory ends the process.
struct NDAssistantModule {
  std::uint32_t interfaceVersion;  ///< `kNDAssistantModuleInterfaceVersion` of the module's build.
  const char* abi;                 ///< `kNDAssistantModuleABI` of the module's build.

  /// Makes a command that does what `request` says; `observer` may be null. Gives null and puts the
  /// reason into `message` when no platform is registered.
  std::shared_ptr<AFServiceCommand> (*makeCommand)(
      const VAHACommand& request, std::shared_ptr<NDAssistantCommandObserver> observer,
      std::string& message);
  /// Makes a sync handler. Null as above.
  std::shared_ptr<AFSyncHandler> (*makeSyncHandler)(std::string& message);
  /// Takes a snapshot of the homes and gives its records, in dictionary form and in order, to
  /// `receive`, once, on a thread of the platform; without configured homes at once and empty.
  /// False, with the reason in `message`, as above; `receive` is then dropped. It must not throw.
  bool (*gatherRecords)(std::function<void(const NDDictionaryList& records)> receive,
                        std::string& message);
  /// Reads from the preferences, as they are now, which messages the plug-in logs and why. False,
  /// with the reason in `message`, as above; `threshold` is then left as it was.
  bool (*readLogThreshold)(NDLogThreshold& threshold, std::string& message);
};

/// The name of the module's one entry, of type `NDAssistantModuleEntryFunction`.
inline constexpr const char kNDAssistantModuleEntryName[] = "NDAssistantModuleEntry";
using NDAssistantModuleEntryFunction = const NDAssistantModule*();

}  // namespace nidus
