#include "Support/FaultyMemory.h"

#include <sqlite3.h>

namespace nidus {
namespace {

struct MemoryState {
  FaultyMemory::Fault fault;
  bool isArmed = false;
  std::int64_t allocations = 0;
  bool hasFailed = false;
};

MemoryState memoryState;
sqlite3_mem_methods realMemory;

bool isToFail() {
  if (!memoryState.isArmed) return false;
  ++memoryState.allocations;
  const bool fails = memoryState.fault.lasts
                         ? memoryState.allocations >= memoryState.fault.firstAllocation
                         : memoryState.allocations == memoryState.fault.firstAllocation;
  memoryState.hasFailed = memoryState.hasFailed || fails;
  return fails;
}

void* allocate(int size) { return isToFail() ? nullptr : realMemory.xMalloc(size); }

void* reallocate(void* memory, int size) {
  return isToFail() ? nullptr : realMemory.xRealloc(memory, size);
}

/// The engine takes another allocator only while it is shut down. A connection's own store of
/// small pieces, of so many bytes and pieces, would hide allocations.
void useAllocator(sqlite3_mem_methods& methods, int lookasideBytes, int lookasidePieces) {
  sqlite3_shutdown();
  sqlite3_config(SQLITE_CONFIG_MALLOC, &methods);
  sqlite3_config(SQLITE_CONFIG_LOOKASIDE, lookasideBytes, lookasidePieces);
  sqlite3_initialize();
}

}  // namespace

FaultyMemory::FaultyMemory() {
  memoryState = MemoryState{};
  sqlite3_shutdown();
  sqlite3_config(SQLITE_CONFIG_GETMALLOC, &realMemory);
  sqlite3_mem_methods methods = realMemory;
  methods.xMalloc = allocate;
  methods.xRealloc = reallocate;
  useAllocator(methods, 0, 0);
}

FaultyMemory::~FaultyMemory() {
  memoryState = MemoryState{};
  constexpr int kUsualBytes = 1200;
  constexpr int kUsualPieces = 40;
  useAllocator(realMemory, kUsualBytes, kUsualPieces);
}

void FaultyMemory::arm(const Fault& fault) { memoryState = MemoryState{fault, true, 0, false}; }

bool FaultyMemory::disarm() {
  memoryState.isArmed = false;
  return memoryState.hasFailed;
}

}  // namespace nidus
