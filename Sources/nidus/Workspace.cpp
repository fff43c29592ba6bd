#include "nidus/Workspace.h"

#include <utility>

namespace nidus {

Result<Session*> Workspace::home() {
  if (!session_) {
    auto options = platformOptionsOf(settings_);
    if (!options) return options.failure();
    auto session = Session::open(std::move(*options));
    if (!session) return session.failure();
    session_ = std::move(*session);
  }
  session_->platform().setLocked(settings_.isLocked);
  return session_.get();
}

Result<Session*> Workspace::assistant() {
  auto session = home();
  if (!session) return session;
  if (auto failure = (*session)->openModule()) return *failure;
  return session;
}

}  // namespace nidus
