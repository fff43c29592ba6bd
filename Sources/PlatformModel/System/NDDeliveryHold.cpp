#include "PlatformModel/System/NDDeliveryHold.h"

#include <utility>

namespace nidus {
namespace {

constinit thread_local NDDeliveryHold* innermostHold = nullptr;

}  // namespace

NDDeliveryHold::NDDeliveryHold() noexcept : outer_(std::exchange(innermostHold, this)) {}

NDDeliveryHold::~NDDeliveryHold() {
  // Still in force while it releases: what a start creates is released after that start, and a
  // start that waits lets go of the starts behind it.
  release();
  innermostHold = outer_;
}

void NDDeliveryHold::whenReleased(NDTask start) {
  if (innermostHold) {
    innermostHold->held_.push_back(std::move(start));
  } else {
    start();
  }
}

void NDDeliveryHold::releaseForWait() {
  if (innermostHold) innermostHold->releaseWithOuter();
}

void NDDeliveryHold::releaseWithOuter() {
  if (outer_) outer_->releaseWithOuter();
  release();
}

void NDDeliveryHold::release() {
  // One at a time, because a start may release the rest itself.
  while (!held_.empty()) {
    const NDTask start = std::move(held_.front());
    held_.erase(held_.begin());
    start();
  }
}

}  // namespace nidus
