#include "Load/ProcessFigures.h"

#include <malloc.h>
#include <unistd.h>

#include <filesystem>
#include <fstream>
#include <iterator>

namespace nidus {
namespace {

std::size_t countOf(const char* folder) {
  const std::filesystem::directory_iterator entries(folder);
  return static_cast<std::size_t>(std::distance(begin(entries), end(entries)));
}

std::size_t residentPages() {
  std::ifstream file("/proc/self/statm");
  std::size_t size = 0;
  std::size_t resident = 0;
  file >> size >> resident;
  return resident;
}

}  // namespace

ProcessFigures ProcessFigures::now() {
  constexpr std::size_t kKiB = 1024;
  malloc_trim(0);  // what the allocator keeps for later says nothing of what is lost
  const auto heap = mallinfo2();
  const auto pageSize = static_cast<std::size_t>(sysconf(_SC_PAGESIZE));
  return {.residentKiB = residentPages() * pageSize / kKiB,
          .allocatedKiB = (heap.uordblks + heap.hblkhd) / kKiB,
          .threads = countOf("/proc/self/task"),
          .descriptors = countOf("/proc/self/fd") - 1};  // without that of the count itself
}

std::string ProcessFigures::text() const {
  return std::to_string(residentKiB) + " KiB resident, " + std::to_string(allocatedKiB) +
         " KiB allocated, " + std::to_string(threads) + " threads, " + std::to_string(descriptors) +
         " descriptors";
}

}  // namespace nidus
