#include "nidus/Doctor/Remedy.h"

#include <gtest/gtest.h>

namespace nidus {
namespace {

TEST(ShellWordTest, QuotesWhereItIsNeeded) {
  EXPECT_EQ(shellWord("Kitchen"), "Kitchen");
  EXPECT_EQ(shellWord("/data/home.db"), "/data/home.db");
  EXPECT_EQ(shellWord("Living Room"), "'Living Room'");
  EXPECT_EQ(shellWord("Chloé's"), R"('Chloé'\''s')");
  EXPECT_EQ(shellWord("$(reboot)"), "'$(reboot)'");
  EXPECT_EQ(shellWord(""), "''");
}

TEST(FindingOfFailureTest, LeavesOutWhatIsNotThere) {
  const Finding finding = findingOf({Failure::Kind::platform, "it is broken"});
  EXPECT_EQ(finding.place, "");
  EXPECT_EQ(finding.message, "it is broken");
  EXPECT_EQ(finding.remedy, "");
}

}  // namespace
}  // namespace nidus
