#include <dlfcn.h>
#include <gtest/gtest.h>
#include <link.h>

#include <string>
#include <system_error>

#include "PlatformModel/NDPlatform.h"
#include "Support/Sanitizers.h"

namespace nidus {
namespace {

/// The library that holds `address`.
const link_map* libraryOf(const void* address) {
  Dl_info info;
  link_map* library = nullptr;
  const int found = dladdr1(address, &info, reinterpret_cast<void**>(&library), RTLD_DL_LINKMAP);
  return found != 0 ? library : nullptr;
}

/// How many functions run when `library` is loaded, those of the compiler's start files included.
std::size_t initializerCount(const link_map& library) {
  for (const ElfW(Dyn)* entry = library.l_ld; entry->d_tag != DT_NULL; ++entry) {
    if (entry->d_tag == DT_INIT_ARRAYSZ) return entry->d_un.d_val / sizeof(void (*)());
  }
  return 0;
}

TEST(LibraryLoadTest, SeesWhatOthersRun) {
  const link_map* library = libraryOf(reinterpret_cast<const void*>(&std::generic_category));
  ASSERT_NE(library, nullptr);
  EXPECT_GT(initializerCount(*library), 1U);
}

TEST(LibraryLoadTest, RunsNothingOfOurs) {
  if (kIsSanitized) GTEST_SKIP() << "the sanitizers add functions of their own";
  const link_map* library = libraryOf(reinterpret_cast<const void*>(&NDPlatform::registered));
  ASSERT_NE(library, nullptr);
  ASSERT_NE(std::string(library->l_name).find("libPlatformModel"), std::string::npos);
  EXPECT_LE(initializerCount(*library), 1U);
}

}  // namespace
}  // namespace nidus
