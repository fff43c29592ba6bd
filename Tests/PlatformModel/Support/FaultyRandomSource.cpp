#include "PlatformModel/Support/FaultyRandomSource.h"

#include <sys/random.h>
#include <sys/syscall.h>
#include <unistd.h>

#include <atomic>
#include <cerrno>

#include "PlatformModel/System/NDExport.h"

namespace nidus {
namespace {

std::atomic<int> errorOfDraws{0};
std::atomic<int> drawsToFail{0};

}  // namespace

FaultyRandomSource::FaultyRandomSource(int error, int draws) {
  errorOfDraws = error;
  drawsToFail = draws;
}

FaultyRandomSource::~FaultyRandomSource() { drawsToFail = 0; }

int FaultyRandomSource::drawsLeft() { return drawsToFail; }

}  // namespace nidus

/// Stands before the function of the system for all libraries of this program.
extern "C" ND_EXPORT ssize_t getrandom(void* buffer, size_t length, unsigned flags) {
  if (nidus::drawsToFail > 0) {
    --nidus::drawsToFail;
    errno = nidus::errorOfDraws;
    return -1;
  }
  return syscall(SYS_getrandom, buffer, length, flags);
}
