#pragma once

namespace nidus {

/// While one lives, every allocation with `new` of its thread fails, in all libraries of the
/// process.
class ScarceMemory {
 public:
  ScarceMemory();
  ~ScarceMemory();
  ScarceMemory(const ScarceMemory&) = delete;
  ScarceMemory& operator=(const ScarceMemory&) = delete;
};

}  // namespace nidus
