#include "Load/LifeWatch.h"

#include <gtest/gtest.h>

namespace nidus {
namespace {

TEST(LifeWatchTest, KnowsWhatIsAlive) {
  LifeWatch lives;
  const auto kept = std::make_shared<int>(1);
  for (int i = 0; i < 10'000; ++i) lives.add("numbers", std::make_shared<int>(i));
  EXPECT_TRUE(lives.survivors().empty());
  lives.add("numbers", kept);
  EXPECT_EQ(lives.survivors(), (std::map<std::string, std::size_t>{{"numbers", 1}}));
}

}  // namespace
}  // namespace nidus
