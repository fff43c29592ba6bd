#pragma once

#include <functional>
#include <memory>

#include "PlatformModel/System/NDNotificationCenter.h"

namespace nidus {

/// The notification centre of one platform. May be used from any thread.
///
///     auto token = center->registerForName_queue_handler(name, queue, handler);
///     center->post(name);
class NotificationCenter final : public NDNotificationCenter {
 public:
  /// `onRegistration` is called, on the registering thread, with the name of each registration
  /// after it was made; may be empty.
  explicit NotificationCenter(std::function<void(const NDString&)> onRegistration);
  ~NotificationCenter() override;

  [[nodiscard]] std::shared_ptr<Token> registerForName_queue_handler(
      const NDString& name, std::shared_ptr<NDQueue> queue, std::function<void()> handler) override;

  /// Queues the handlers that are registered for `name`. A registration that ends before its
  /// handler has begun is not called.
  void post(const NDString& name);

 private:
  class Registration;
  struct State;

  const std::function<void(const NDString&)> onRegistration_;
  const std::shared_ptr<State> state_;
};

}  // namespace nidus
