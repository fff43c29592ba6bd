#include "nidus/Workspace.h"

#include <utility>

namespace nidus {

Result<Session*> Workspace::home() {
  if (!session_) {
    auto opened = options();
    if (!opened) return opened.failure();
    auto session = Session::open(std::move(*opened));
    if (!session) return session.failure();
    session_ = std::move(*session);
  }
  session_->platform().setLocked(settings_.isLocked);
  return session_.get();
}

Result<HomePlatformOptions> Workspace::options() const {
  if (options_) return *options_;
  return platformOptionsOf(settings_);
}

Result<Session*> Workspace::assistant() {
  auto session = home();
  if (!session) return session;
  if (auto failure = (*session)->openModule()) return *failure;
  return session;
}

}  // namespace nidus
