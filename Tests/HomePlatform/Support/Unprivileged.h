#pragma once

#include <sys/types.h>

namespace nidus {

/// Takes away the rights that let an administrator write everything, as long as it lives, so that
/// tests of permissions mean something for whoever runs them.
class Unprivileged {
 public:
  Unprivileged();
  ~Unprivileged();
  Unprivileged(const Unprivileged&) = delete;
  Unprivileged& operator=(const Unprivileged&) = delete;

 private:
  uid_t before_;
};

}  // namespace nidus
