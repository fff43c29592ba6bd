#include "Logging/WLOLog.h"

#include <gtest/gtest.h>

namespace nidus {
namespace {

TEST(WLOLogTest, ExportsTheKeyOfTheLevel) { EXPECT_STREQ(kWLOLogLevelKey, "NidusLogLevel"); }

}  // namespace
}  // namespace nidus
