#include "nidus/Doctor/Remedy.h"

#include <gtest/gtest.h>

namespace nidus {
namespace {

TEST(FindingOfFailureTest, LeavesOutWhatIsNotThere) {
  const Finding finding = findingOf({Failure::Kind::platform, "it is broken"});
  EXPECT_EQ(finding.place, "");
  EXPECT_EQ(finding.message, "it is broken");
  EXPECT_EQ(finding.remedy, "");
}

}  // namespace
}  // namespace nidus
