#include "HomePlatform/Support/Unprivileged.h"

#include <unistd.h>

#include <stdexcept>

namespace nidus {
namespace {

constexpr uid_t kNobody = 65534;

}  // namespace

Unprivileged::Unprivileged() : before_(::geteuid()) {
  if (before_ == 0 && ::seteuid(kNobody) != 0) throw std::runtime_error("cannot become nobody");
}

Unprivileged::~Unprivileged() {
  if (before_ == 0 && ::seteuid(before_) != 0) ::_exit(1);
}

}  // namespace nidus
