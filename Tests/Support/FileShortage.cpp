#include "Support/FileShortage.h"

#include <unistd.h>

#include <vector>

namespace nidus {
namespace {

/// The number that a descriptor would have that is opened after `spare` others.
int numberAfter(std::size_t spare) {
  std::vector<int> opened;
  while (opened.size() <= spare) opened.push_back(::dup(STDERR_FILENO));
  for (const int descriptor : opened) ::close(descriptor);
  return opened.back();
}

}  // namespace

FileShortage::FileShortage(std::size_t spare) {
  ::getrlimit(RLIMIT_NOFILE, &usual_);
  rlimit lowered = usual_;
  lowered.rlim_cur = static_cast<rlim_t>(numberAfter(spare));
  ::setrlimit(RLIMIT_NOFILE, &lowered);
}

FileShortage::~FileShortage() { ::setrlimit(RLIMIT_NOFILE, &usual_); }

}  // namespace nidus
