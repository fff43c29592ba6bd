#pragma once

#include <cstddef>
#include <memory>
#include <string_view>
#include <utility>

#include "Assistant/NDAssistantCommand.h"
#include "Assistant/ResultMaker.h"
#include "PlatformModel/System/NDWaitGroup.h"

namespace nidus {

/// One action that asks homes: what was asked and who hears of it, the results of all its batches,
/// and the group that joins the batches.
///
/// Batches answer on any threads, at the same time; each holds the run until it has answered. What
/// waits for the report does not hold the run, so that a group which is never left goes with the
/// last batch.
///
///     run->enter();
///     home.readCharacteristicValues_withCompletionHandler(list, [run](auto& error, auto& all) {
///       const ActionRun::Answer answer(*run);
///       ActionRun::ResultWriter results(*run);
///       for (const auto& response : all) results.add(...);
///     });
///     run->reportWhenAnswered();
class ActionRun {
  class ResultList;

 public:
  /// Adds results to the run, of one batch or one thread.
  class ResultWriter {
   public:
    explicit ResultWriter(const ActionRun& run)
        : results_(run.results_), maker_(run.action_, run.serviceType_) {}
    /// Adds a result about `service`, which may be null.
    void add(std::string_view outcome, const std::shared_ptr<NDService>& service);
    /// The same, unless the result turns out to be no answer to the action.
    void addIfAnswer(std::string_view outcome, const std::shared_ptr<NDService>& service);

   private:
    const std::shared_ptr<ResultList> results_;
    ResultMaker maker_;
  };

  /// Stands for a batch that has been answered: leaves the group when it goes, on every path.
  class Answer {
   public:
    explicit Answer(const ActionRun& run) : group_(run.group_) {}
    Answer(Answer&&) noexcept = default;
    Answer& operator=(Answer&&) = delete;
    ~Answer() { leave(); }
    /// Leaves the group now.
    void leave() {
      if (const auto group = std::exchange(group_, nullptr)) group->leave();
    }
    /// Keeps the group entered for good, or until another answer leaves it.
    void stayEntered() { group_ = nullptr; }

   private:
    std::shared_ptr<NDWaitGroup> group_;
  };

  /// `command` is never null; the others may be. Makes room for `expected` results.
  ActionRun(std::shared_ptr<const NDAssistantCommand> command, VAHAActionRef action,
            NDString serviceType, VAHAReplyHandler handler, std::size_t expected);
  ~ActionRun();

  [[nodiscard]] const NDAssistantCommand& command() const { return *command_; }
  [[nodiscard]] const VAHAActionRef& action() const { return action_; }

  /// Enters the group, before a home is asked.
  void enter() const { group_->enter(); }
  /// Reports all results on the main queue as soon as every batch has left the group. Called once,
  /// after the last home was asked.
  void reportWhenAnswered() const;
  /// Reports at once that the device must be unlocked.
  void reportUnlockRequired() const { command_->reportUnlockRequired(handler_); }

 private:
  const std::shared_ptr<const NDAssistantCommand> command_;
  const VAHAActionRef action_;
  const NDString serviceType_;
  const VAHAReplyHandler handler_;
  const std::shared_ptr<ResultList> results_;
  const std::shared_ptr<NDWaitGroup> group_;
};

}  // namespace nidus
