#include "PlatformModel/Assistant/NDAssistantModule.h"

#include <dlfcn.h>
#include <gtest/gtest.h>

#include <stdexcept>

namespace nidus {
namespace {

/// Opens the module as a host does and gives what it offers; never null.
const NDAssistantModule* openModule() {
  void* const library = dlopen(NIDUS_MODULE_FILE, RTLD_NOW | RTLD_LOCAL);
  if (!library) throw std::runtime_error(dlerror());
  void* const entry = dlsym(library, kNDAssistantModuleEntryName);
  if (!entry) throw std::runtime_error(dlerror());
  return reinterpret_cast<NDAssistantModuleEntryFunction*>(entry)();
}

TEST(NDAssistantModuleTest, TellsItsVersions) {
  EXPECT_EQ(openModule()->interfaceVersion, kNDAssistantModuleInterfaceVersion);
  EXPECT_STREQ(openModule()->abi, kNDAssistantModuleABI);
}

}  // namespace
}  // namespace nidus
