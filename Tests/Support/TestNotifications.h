#pragma once

#include <functional>
#include <memory>
#include <utility>
#include <vector>

#include "PlatformModel/System/NDNotificationCenter.h"

namespace nidus {

/// A notification centre that keeps its registrations for good. Used by one thread.
class TestNotifications final : public NDNotificationCenter {
 public:
  struct Registration {
    NDString name;
    std::shared_ptr<NDQueue> queue;
    std::function<void()> handler;
  };

  [[nodiscard]] std::shared_ptr<Token> registerForName_queue_handler(
      const NDString& name, std::shared_ptr<NDQueue> queue,
      std::function<void()> handler) override {
    registrations_.push_back({name, std::move(queue), std::move(handler)});
    return std::make_shared<Token>();
  }

  [[nodiscard]] const std::vector<Registration>& registrations() const { return registrations_; }

  /// Calls all handlers on the calling thread, so that the change is seen at once.
  void post() const {
    for (const Registration& registration : registrations_) registration.handler();
  }

 private:
  std::vector<Registration> registrations_;
};

}  // namespace nidus
