#pragma once

#include <functional>
#include <memory>
#include <vector>

#include "HomePlatform/Result.h"
#include "PlatformModel/Assistant/NDAssistantModule.h"
#include "PlatformModel/Assistant/VAHACommand.h"
#include "PlatformModel/System/NDDictionary.h"
#include "PlatformModel/System/NDMainQueue.h"

namespace nidus {

/// Has the plug-in perform commands and take snapshots, one at a time, and waits for the answers.
///
/// Used by one thread at a time: the one that drains the main queue.
///
///     CommandRunner runner(*module, platform->mainQueue());
///     auto replies = runner.perform(*command);
///     if (replies && replies->empty()) say("no reply");
class CommandRunner {
 public:
  /// `mainQueue`, never null, is drained while the runner waits. `drain` is for a platform that
  /// does all its work on the thread that drains: it is called instead, once for each wait; empty
  /// for a platform with threads of its own.
  CommandRunner(const NDAssistantModule& module, std::shared_ptr<NDMainQueue> mainQueue,
                std::function<void()> drain = {});

  /// Performs `request` and gives its replies in the order in which they came, in dictionary form:
  /// usually one, sometimes two, none for a command that ended without a reply or that a drained
  /// platform left without an answer. `observer` may be null. Waits without limit for a platform
  /// with threads. Fails, as the platform's fault, when the module makes no command.
  [[nodiscard]] Result<std::vector<NDDictionary>> perform(
      const VAHACommand& request, std::shared_ptr<NDAssistantCommandObserver> observer = nullptr);

  /// Takes a snapshot of the homes and gives its records in dictionary form and in order; empty
  /// without homes. Waits and fails like `perform`.
  [[nodiscard]] Result<NDDictionaryList> records();

 private:
  void waitUntil(const std::function<bool()>& isDone);

  const NDAssistantModule& module_;
  const std::shared_ptr<NDMainQueue> mainQueue_;
  const std::function<void()> drain_;
};

}  // namespace nidus
