#include "nidus/SystemLibrary.h"

#include <dlfcn.h>

#include <string>

namespace nidus {
namespace {

void* present(void* found) {
  if (found) return found;
  throw MissingLibrary(std::string(dlerror()) + "; install the library that the program needs");
}

}  // namespace

SystemLibrary::SystemLibrary(const char* name)
    : library_(present(dlopen(name, RTLD_NOW | RTLD_LOCAL | RTLD_NODELETE))) {}

void* SystemLibrary::address(const char* name) const { return present(dlsym(library_, name)); }

}  // namespace nidus
