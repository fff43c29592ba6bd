#include "SeededRandom.h"

#include <sys/random.h>
#include <sys/syscall.h>
#include <unistd.h>

#include <cstdint>
#include <random>

namespace nidus {
namespace {

bool isSeeded = false;
std::mt19937 generator;  // NOLINT(bugprone-random-generator-seed): it has to be the same each time

}  // namespace

void seedRandomSource() { isSeeded = true; }

}  // namespace nidus

/// Stands before the system's own for the program and its libraries.
extern "C" __attribute__((visibility("default"))) ssize_t getrandom(void* buffer, size_t length,
                                                                    unsigned flags) {
  if (!nidus::isSeeded) return syscall(SYS_getrandom, buffer, length, flags);
  auto* const bytes = static_cast<std::uint8_t*>(buffer);
  for (size_t i = 0; i < length; ++i) bytes[i] = static_cast<std::uint8_t>(nidus::generator());
  return static_cast<ssize_t>(length);
}
