#include "CountedMemory.h"

#include <malloc.h>

#include <algorithm>
#include <cstdlib>
#include <new>

namespace nidus {
namespace {

struct Count {
  bool isOn = false;
  std::ptrdiff_t held = 0;
  std::ptrdiff_t peak = 0;
};
constinit thread_local Count bytes;

void* allocate(std::size_t size) noexcept {
  void* block = std::malloc(size == 0 ? 1 : size);
  if (block && bytes.isOn) {
    bytes.held += static_cast<std::ptrdiff_t>(malloc_usable_size(block));
    bytes.peak = std::max(bytes.peak, bytes.held);
  }
  return block;
}

void release(void* block) noexcept {
  if (block && bytes.isOn) bytes.held -= static_cast<std::ptrdiff_t>(malloc_usable_size(block));
  std::free(block);
}

}  // namespace

CountedMemory::CountedMemory() { bytes = {true, 0, 0}; }
CountedMemory::~CountedMemory() { bytes.isOn = false; }
std::ptrdiff_t CountedMemory::peak() { return bytes.peak; }
std::ptrdiff_t CountedMemory::held() { return bytes.held; }

}  // namespace nidus

void* operator new(std::size_t size) {
  if (void* block = nidus::allocate(size)) return block;
  throw std::bad_alloc();
}
void* operator new[](std::size_t size) { return operator new(size); }
void operator delete(void* block) noexcept { nidus::release(block); }
void operator delete[](void* block) noexcept { nidus::release(block); }
void operator delete(void* block, std::size_t /*size*/) noexcept { nidus::release(block); }
void operator delete[](void* block, std::size_t /*size*/) noexcept { nidus::release(block); }
