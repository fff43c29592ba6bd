#include "HomePlatform/System/TrackedQueue.h"

#include <utility>

namespace nidus {
namespace {

/// The token comes first, so that it is released after all that the task holds.
struct TrackedTask {
  WorkToken token;
  NDTask task;
  void operator()() const { task(); }
};

}  // namespace

void TrackedQueue::async(NDTask task) {
  queue_.async(TrackedTask{WorkToken(tracker_), std::move(task)});
}

}  // namespace nidus
