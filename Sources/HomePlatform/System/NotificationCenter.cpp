#include "HomePlatform/System/NotificationCenter.h"

#include <algorithm>
#include <utility>
#include <vector>

#include "PlatformModel/System/NDMutex.h"

namespace nidus {

/// The registrations that live, in the order in which they were made. Tokens outlive the centre.
struct NotificationCenter::State {
  NDMutex mutex;
  std::vector<std::pair<const Registration*, std::weak_ptr<Registration>>> registrations
      ND_GUARDED_BY(mutex);
};

class NotificationCenter::Registration final : public Token {
 public:
  Registration(std::shared_ptr<State> state, NDString name, std::shared_ptr<NDQueue> queue,
               std::function<void()> handler)
      : state_(std::move(state)),
        name_(std::move(name)),
        queue_(std::move(queue)),
        handler_(std::move(handler)) {}

  ~Registration() override {
    const NDLock lock(state_->mutex);
    auto& all = state_->registrations;
    all.erase(std::remove_if(all.begin(), all.end(),
                             [this](const auto& entry) { return entry.first == this; }),
              all.end());
  }

  [[nodiscard]] const NDString& name() const { return name_; }

  static void queueHandler(const std::shared_ptr<Registration>& registration) {
    registration->queue_->async([weak = std::weak_ptr<Registration>(registration)] {
      if (const auto self = weak.lock()) self->handler_();
    });
  }

 private:
  const std::shared_ptr<State> state_;
  const NDString name_;
  const std::shared_ptr<NDQueue> queue_;
  const std::function<void()> handler_;
};

NotificationCenter::NotificationCenter(std::function<void(const NDString&)> onRegistration)
    : onRegistration_(std::move(onRegistration)), state_(std::make_shared<State>()) {}

NotificationCenter::~NotificationCenter() = default;

std::shared_ptr<NDNotificationCenter::Token> NotificationCenter::registerForName_queue_handler(
    const NDString& name, std::shared_ptr<NDQueue> queue, std::function<void()> handler) {
  auto registration =
      std::make_shared<Registration>(state_, name, std::move(queue), std::move(handler));
  {
    const NDLock lock(state_->mutex);
    state_->registrations.emplace_back(registration.get(), registration);
  }
  if (onRegistration_) onRegistration_(name);
  return registration;
}

void NotificationCenter::post(const NDString& name) {
  std::vector<std::shared_ptr<Registration>> live;
  {
    const NDLock lock(state_->mutex);
    for (const auto& entry : state_->registrations) {
      if (auto registration = entry.second.lock()) live.push_back(std::move(registration));
    }
  }
  for (const auto& registration : live) {
    if (registration->name() == name) Registration::queueHandler(registration);
  }
}

}  // namespace nidus
