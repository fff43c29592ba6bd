#include "PlatformModel/System/NDSystemLog.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace nidus {
namespace {

using testing::ElementsAre;
using testing::Pair;

TEST(NDSystemLogMessageTest, HoldsFieldsByKey) {
  NDSystemLogMessage message;
  message.set("Level", "6");
  message.set("Facility", "f");
  message.set("Level", "3");
  EXPECT_THAT(message.fields(), ElementsAre(Pair("Facility", "f"), Pair("Level", "3")));
}

}  // namespace
}  // namespace nidus
