#include "nidus/Explain/Rehearsal.h"

#include <gtest/gtest.h>

#include <sstream>

#include "AssistantHost/CommandReader.h"
#include "HomePlatform/Store/HomeDocument.h"
#include "Support/TestFolder.h"
#include "nidus/ProgramTest.h"

namespace nidus {
namespace {

/// Rehearses within one process, as a shell does.
class RehearsalTest : public ::testing::Test {
 protected:
  RehearsalTest() { workspace_.settings().dataFolder = folder_.file("data"); }

  void importSmallHome() {
    std::istringstream document(documentOf({smallHome()}));
    const auto homes = readHomeDocument(document, "small home");
    const auto session = workspace_.home();
    ASSERT_TRUE(session) << session.failure().message;
    ASSERT_FALSE((*session)->platform().importHomes(*homes, false));
  }

  /// The homes of the workspace as a document.
  [[nodiscard]] std::string exported() {
    std::ostringstream document;
    writeHomeDocument(document, *(*workspace_.home())->platform().exportHomes(), true);
    return document.str();
  }

  [[nodiscard]] std::size_t repliesOf(const std::string& command) {
    const auto session = workspace_.assistant();
    return (*session)->runner().perform(**readCommand(command, "test"))->size();
  }

  const TestFolder folder_;
  Workspace workspace_;
};

TEST_F(RehearsalTest, SeesStepsReachCallsAndReplies) {
  importSmallHome();
  const auto stage = RehearsalStage::open(workspace_);
  ASSERT_TRUE(stage) << stage.failure().message;
  const auto rehearsal = (*stage)->perform(**readCommand(setCommandLine("Lamp", false), "test"));
  ASSERT_TRUE(rehearsal);
  EXPECT_EQ(rehearsal->steps.front().name, "snapshot");
  EXPECT_EQ(rehearsal->steps.back().name, "serviceName");
  EXPECT_EQ(rehearsal->reached.size(), 1U);
  ASSERT_EQ(rehearsal->calls.size(), 1U);
  EXPECT_EQ(rehearsal->calls.front().kind, PlatformCall::Kind::write);
  EXPECT_EQ(rehearsal->replies.size(), 1U);
  EXPECT_FALSE(
      rehearsal->after[0].accessories[0].services[0].characteristics[0].value->boolValue());
  EXPECT_TRUE(
      (*stage)->homes()[0].accessories[0].services[0].characteristics[0].value->boolValue());
}

TEST_F(RehearsalTest, StartsEachCommandWithNothingSeen) {
  importSmallHome();
  const auto stage = RehearsalStage::open(workspace_);
  ASSERT_TRUE(stage);
  for (int i = 0; i < 2; ++i) {
    const auto rehearsal = (*stage)->perform(**readCommand(readCommandLine("Lamp"), "test"));
    ASSERT_TRUE(rehearsal);
    EXPECT_EQ(rehearsal->calls.size(), 1U);
    EXPECT_EQ(rehearsal->replies.size(), 1U);
  }
}

TEST_F(RehearsalTest, LeavesTheWorkspaceToTheNextCommand) {
  importSmallHome();
  const std::string before = exported();
  EXPECT_EQ(repliesOf(readCommandLine("Lamp")), 1U);
  {
    const auto stage = RehearsalStage::open(workspace_);
    ASSERT_TRUE(stage);
    const auto rehearsal = (*stage)->perform(**readCommand(setCommandLine("Lamp", false), "test"));
    ASSERT_TRUE(rehearsal);
    EXPECT_EQ(rehearsal->replies.size(), 1U);
  }
  EXPECT_EQ(exported(), before);
  EXPECT_EQ(repliesOf(setCommandLine("Lamp", false)), 1U);
  EXPECT_NE(exported(), before);
}

TEST_F(RehearsalTest, FailsWhenThereIsNoFolder) {
  workspace_.settings().dataFolder = folder_.write("file", "");
  const auto stage = RehearsalStage::open(workspace_);
  ASSERT_FALSE(stage);
  EXPECT_NE(stage.failure().message.find(folder_.file("file")), std::string::npos);
}

}  // namespace
}  // namespace nidus
