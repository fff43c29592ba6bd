#pragma once

#include <functional>
#include <memory>
#include <utility>
#include <vector>

#include "PlatformModel/System/NDMainQueue.h"
#include "PlatformModel/System/NDMutex.h"

namespace nidus {

/// Collects what is handed to a handler until the handler is gone, which is how the plug-in says
/// that no more will come.
///
/// May be used from any thread; a host that waits in `NDMainQueue::runUntil` is woken at the end.
///
///     auto replies = std::make_shared<AnswerCollector<NDDictionary>>();
///     command->performWithCompletion(AnswerCollector<NDDictionary>::handler(replies, mainQueue));
///     mainQueue->runUntil([replies] { return replies->isOver(); });
template <class Answer>
class AnswerCollector {
 public:
  /// Makes the handler of `collector`; once, as the end of its last copy is the end of all answers.
  [[nodiscard]] static std::function<void(const Answer&)> handler(
      std::shared_ptr<AnswerCollector> collector, std::shared_ptr<NDMainQueue> mainQueue) {
    auto end = std::make_shared<const EndOfAnswers>(std::move(collector), std::move(mainQueue));
    return [end](const Answer& answer) { end->collector->add(answer); };
  }

  /// Whether the handler is gone.
  [[nodiscard]] bool isOver() {
    const NDLock lock(mutex_);
    return isOver_;
  }

  /// Takes what has come so far, in order.
  [[nodiscard]] std::vector<Answer> take() {
    const NDLock lock(mutex_);
    return std::exchange(answers_, {});
  }

 private:
  struct EndOfAnswers {
    EndOfAnswers(std::shared_ptr<AnswerCollector> answers, std::shared_ptr<NDMainQueue> queue)
        : collector(std::move(answers)), mainQueue(std::move(queue)) {}
    EndOfAnswers(const EndOfAnswers&) = delete;
    EndOfAnswers& operator=(const EndOfAnswers&) = delete;
    ~EndOfAnswers() {
      collector->end();
      mainQueue->wake();
    }
    const std::shared_ptr<AnswerCollector> collector;
    const std::shared_ptr<NDMainQueue> mainQueue;
  };

  void add(const Answer& answer) {
    const NDLock lock(mutex_);
    answers_.push_back(answer);
  }
  void end() {
    const NDLock lock(mutex_);
    isOver_ = true;
  }

  NDMutex mutex_;
  std::vector<Answer> answers_ ND_GUARDED_BY(mutex_);
  bool isOver_ ND_GUARDED_BY(mutex_) = false;
};

}  // namespace nidus
