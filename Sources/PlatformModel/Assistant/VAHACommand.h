#pragma once

#include <functional>
#include <memory>
#include <utility>
#include <vector>

#include "PlatformModel/Assistant/VAHAAction.h"
#include "PlatformModel/Assistant/VAHAActionResult.h"
#include "PlatformModel/Assistant/VAHAFilter.h"
#include "PlatformModel/System/NDDictionary.h"
#include "PlatformModel/System/NDExport.h"
#include "PlatformModel/System/NDString.h"

namespace nidus {

/// A home-automation command: what to act on and what to do. Not synchronised; nobody changes a
/// command that is being performed.
class ND_EXPORT VAHACommand {
 public:
  VAHACommand() = default;
  virtual ~VAHACommand();

  /// May be null.
  [[nodiscard]] const std::shared_ptr<const VAHAFilter>& filter() const noexcept { return filter_; }
  void setFilter(std::shared_ptr<const VAHAFilter> filter) { filter_ = std::move(filter); }
  /// In order; none is null.
  [[nodiscard]] const std::vector<VAHAActionRef>& actions() const noexcept { return actions_; }
  void setActions(std::vector<VAHAActionRef> actions) { actions_ = std::move(actions); }

 protected:
  VAHACommand(const VAHACommand&) = default;
  VAHACommand& operator=(const VAHACommand&) = default;

 private:
  std::shared_ptr<const VAHAFilter> filter_;
  std::vector<VAHAActionRef> actions_;
};

/// The reply to a command. Not synchronised.
class ND_EXPORT VAHACommandCompleted {
 public:
  /// Makes an empty reply, never null.
  [[nodiscard]] static std::shared_ptr<VAHACommandCompleted> commandCompleted();

  [[nodiscard]] const NDString& commandOutcome() const noexcept { return commandOutcome_; }
  void setCommandOutcome(NDString outcome) { commandOutcome_ = std::move(outcome); }
  /// In order; none is null.
  using Results = std::vector<std::shared_ptr<const VAHAActionResult>>;
  [[nodiscard]] const Results& actionResults() const noexcept { return actionResults_; }
  void setActionResults(Results results) { actionResults_ = std::move(results); }

  /// The plain form: "commandOutcome" and "actionResults".
  [[nodiscard]] NDDictionary dictionary() const;

 private:
  NDString commandOutcome_;
  Results actionResults_;
};

/// Takes a reply in its dictionary form; may be empty. It is called on a thread of the platform
/// (no homes, no match, unlock, scene) or by the drainer of the main queue (results), and a command
/// whose batches meet a locked accessory calls it more than once, even at the same time.
using VAHAReplyHandler = std::function<void(const NDDictionary& reply)>;

}  // namespace nidus
