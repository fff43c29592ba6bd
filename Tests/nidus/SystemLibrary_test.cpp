#include "nidus/SystemLibrary.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace nidus {
namespace {

using testing::AllOf;
using testing::HasSubstr;
using testing::ThrowsMessage;

constexpr const char kMathematics[] = "libm.so.6";

TEST(SystemLibraryTest, CallsFunctionsOfLibrary) {
  const SystemLibrary mathematics(kMathematics);
  EXPECT_EQ(mathematics.function<double(double)>("floor")(2.5), 2.0);
}

TEST(SystemLibraryTest, NamesLibraryThatIsMissing) {
  EXPECT_THAT([] { SystemLibrary("libnidus-none.so.1"); },
              ThrowsMessage<MissingLibrary>(
                  AllOf(HasSubstr("libnidus-none.so.1"), HasSubstr("; install the library"))));
}

TEST(SystemLibraryTest, NamesFunctionThatIsMissing) {
  const SystemLibrary mathematics(kMathematics);
  EXPECT_THAT([&] { static_cast<void>(mathematics.function<void()>("nidusNone")); },
              ThrowsMessage<MissingLibrary>(AllOf(HasSubstr("libm"), HasSubstr("nidusNone"))));
}

}  // namespace
}  // namespace nidus
