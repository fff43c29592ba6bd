#include "Module/ScarceMemory.h"

#include <cstdlib>
#include <new>

namespace nidus {
namespace {

constinit thread_local bool isScarce = false;

}  // namespace

ScarceMemory::ScarceMemory() { isScarce = true; }

ScarceMemory::~ScarceMemory() { isScarce = false; }

}  // namespace nidus

// These replace the operators of the standard library for the whole process.

void* operator new(std::size_t size) {
  void* const block = nidus::isScarce ? nullptr : std::malloc(size == 0 ? 1 : size);
  if (!block) throw std::bad_alloc();
  return block;
}

void operator delete(void* block) noexcept { std::free(block); }

void operator delete(void* block, std::size_t /*size*/) noexcept { std::free(block); }
