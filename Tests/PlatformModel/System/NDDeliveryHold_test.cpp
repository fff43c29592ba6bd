#include "PlatformModel/System/NDDeliveryHold.h"

#include <gtest/gtest.h>

#include <memory>
#include <optional>
#include <string>
#include <thread>

namespace nidus {
namespace {

class NDDeliveryHoldTest : public testing::Test {
 protected:
  void start(const std::string& name) {
    NDDeliveryHold::whenReleased([this, name] { started_ += name; });
  }

  std::string started_;
};

TEST_F(NDDeliveryHoldTest, WithoutHoldStartsAtOnce) {
  start("a");
  EXPECT_EQ(started_, "a");
}

TEST_F(NDDeliveryHoldTest, StartsInOrderWhenItEnds) {
  {
    const NDDeliveryHold hold;
    start("a");
    start("b");
    EXPECT_EQ(started_, "");
  }
  EXPECT_EQ(started_, "ab");
  start("c");
  EXPECT_EQ(started_, "abc");
}

TEST_F(NDDeliveryHoldTest, InnermostHoldEndsFirst) {
  {
    const NDDeliveryHold outer;
    start("a");
    {
      const NDDeliveryHold inner;
      start("b");
    }
    EXPECT_EQ(started_, "b");
    start("c");
    EXPECT_EQ(started_, "b");
  }
  EXPECT_EQ(started_, "bac");
}

TEST_F(NDDeliveryHoldTest, WaitReleasesOutermostFirst) {
  const NDDeliveryHold outer;
  start("a");
  const NDDeliveryHold middle;
  start("b");
  const NDDeliveryHold inner;
  start("c");
  NDDeliveryHold::releaseForWait();
  EXPECT_EQ(started_, "abc");
}

TEST_F(NDDeliveryHoldTest, StaysInForceAfterWait) {
  {
    const NDDeliveryHold hold;
    start("a");
    NDDeliveryHold::releaseForWait();
    start("b");
    EXPECT_EQ(started_, "a");
    NDDeliveryHold::releaseForWait();
    EXPECT_EQ(started_, "ab");
    start("c");
  }
  EXPECT_EQ(started_, "abc");
}

TEST_F(NDDeliveryHoldTest, WaitWithoutHoldDoesNothing) {
  NDDeliveryHold::releaseForWait();
  EXPECT_EQ(started_, "");
}

TEST_F(NDDeliveryHoldTest, WaitReleasesWhatStartsHoldBack) {
  const NDDeliveryHold hold;
  NDDeliveryHold::whenReleased([this] {
    start("b");
    started_ += "a";
  });
  NDDeliveryHold::releaseForWait();
  EXPECT_EQ(started_, "ab");
}

TEST_F(NDDeliveryHoldTest, EndReleasesWhatStartsHoldBack) {
  {
    const NDDeliveryHold hold;
    NDDeliveryHold::whenReleased([this] {
      start("b");
      started_ += "a";
    });
  }
  EXPECT_EQ(started_, "ab");
}

TEST_F(NDDeliveryHoldTest, StartThatWaitsReleasesThoseBehindIt) {
  {
    const NDDeliveryHold hold;
    NDDeliveryHold::whenReleased([this] {
      NDDeliveryHold::releaseForWait();
      started_ += "a";
    });
    start("b");
  }
  EXPECT_EQ(started_, "ba");
}

TEST_F(NDDeliveryHoldTest, BelongsToItsThread) {
  const NDDeliveryHold hold;
  start("a");
  std::thread([this] {
    NDDeliveryHold::releaseForWait();
    start("b");
  }).join();
  EXPECT_EQ(started_, "b");
  NDDeliveryHold::releaseForWait();
}

TEST_F(NDDeliveryHoldTest, ReleasesStartAfterIt) {
  auto held = std::make_shared<int>();
  const std::weak_ptr<int> isHeld = held;
  std::optional<NDDeliveryHold> hold(std::in_place);
  NDDeliveryHold::whenReleased([held = std::move(held)] {});
  EXPECT_FALSE(isHeld.expired());
  hold.reset();
  EXPECT_TRUE(isHeld.expired());
}

}  // namespace
}  // namespace nidus
