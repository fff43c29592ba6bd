#include "PlatformModel/System/NDSerialQueue.h"

#include <deque>
#include <utility>

#include "PlatformModel/System/NDMutex.h"

namespace nidus {

/// The work of one serial queue. At most one turn of it is on the target at any time, which keeps
/// the order; each turn runs one piece, so that queues which share a target take turns.
struct NDSerialQueue::State : std::enable_shared_from_this<State> {
  class Turn;

  explicit State(std::shared_ptr<NDQueue> targetQueue) : target(std::move(targetQueue)) {}

  void add(NDTask task);
  void runOne();
  void dropAll();
  NDTask takeFirst();
  bool endTurn();
  void postTurn();

  const std::shared_ptr<NDQueue> target;
  NDMutex mutex;
  std::deque<NDTask> tasks ND_GUARDED_BY(mutex);
  bool hasTurn ND_GUARDED_BY(mutex) = false;
};

/// A turn that has not been taken when it is destroyed was dropped by the target, and with it goes
/// all work that waits behind it: nobody would run it, and it may hold this very queue.
class NDSerialQueue::State::Turn {
 public:
  explicit Turn(std::shared_ptr<State> state) : state_(std::move(state)) {}
  ~Turn() {
    if (state_) state_->dropAll();
  }
  Turn(const Turn&) = delete;
  Turn& operator=(const Turn&) = delete;

  void take() {
    const std::shared_ptr<State> state = std::move(state_);
    state->runOne();
  }

 private:
  std::shared_ptr<State> state_;
};

void NDSerialQueue::State::add(NDTask task) {
  {
    const NDLock lock(mutex);
    tasks.push_back(std::move(task));
    if (std::exchange(hasTurn, true)) return;
  }
  postTurn();
}

void NDSerialQueue::State::runOne() {
  takeFirst()();  // destroyed here, before the next piece may run
  if (endTurn()) postTurn();
}

NDTask NDSerialQueue::State::takeFirst() {
  const NDLock lock(mutex);
  NDTask task = std::move(tasks.front());
  tasks.pop_front();
  return task;
}

/// Says whether work is left, for which the turn then goes on.
bool NDSerialQueue::State::endTurn() {
  const NDLock lock(mutex);
  hasTurn = !tasks.empty();
  return hasTurn;
}

void NDSerialQueue::State::postTurn() {
  target->async([turn = std::make_shared<Turn>(shared_from_this())] { turn->take(); });
}

void NDSerialQueue::State::dropAll() {
  std::deque<NDTask> dropped;
  const NDLock lock(mutex);
  dropped.swap(tasks);
  hasTurn = false;
}

NDSerialQueue::NDSerialQueue(NDString label, std::shared_ptr<NDQueue> target)
    : label_(std::move(label)), state_(std::make_shared<State>(std::move(target))) {}

NDSerialQueue::~NDSerialQueue() = default;

void NDSerialQueue::async(NDTask task) { state_->add(std::move(task)); }

}  // namespace nidus
