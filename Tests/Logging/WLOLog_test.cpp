#include "Logging/WLOLog.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cstddef>
#include <cstdint>
#include <functional>
#include <string>
#include <thread>
#include <vector>

#include "Support/FreshProcess.h"
#include "Support/TestPlatform.h"

namespace nidus {
namespace {

using ::testing::AllOf;
using ::testing::Contains;
using ::testing::ElementsAre;
using ::testing::IsEmpty;
using ::testing::Not;
using ::testing::Pair;
using ::testing::UnorderedElementsAre;

constexpr const char* kDeveloperLevelKey = "NidusDeveloperLogLevel";

constexpr std::size_t kThreadCount = 8;

void onManyThreads(const std::function<void()>& work) {
  std::vector<std::thread> threads;
  for (std::size_t i = 0; i < kThreadCount; ++i) threads.emplace_back(work);
  for (std::thread& thread : threads) thread.join();
}

struct Lamp {};
std::string description(const Lamp& /*lamp*/) { return "a lamp"; }

/// Each test whose log opens does so in a process of its own, because the log opens once.
class WLOLogTest : public ::testing::Test {
 protected:
  WLOLogTest() { EXPECT_EQ(NDPlatform::registerPlatform(TestPlatform::shared()), ""); }
  ~WLOLogTest() override { NDPlatform::unregisterPlatform(TestPlatform::shared()); }

  static TestPlatform& platform() { return *TestPlatform::shared(); }
  static TestLog& systemLog() { return platform().testLog(); }
  static void setPreference(const std::string& key, std::int64_t level) {
    platform().testPreferences().setInteger(key, level);
  }
  static void notifyOfChange() { platform().testNotifications().post(); }

  /// The greatest level from 0 to 31 that is logged.
  static int threshold() {
    int level = 31;
    while (level > 0 && !WLOShouldLogAtLevel(level)) --level;
    for (int lower = 0; lower < level; ++lower) EXPECT_TRUE(WLOShouldLogAtLevel(lower));
    return level;
  }
  /// The text of the one message that `format` and `arguments` make.
  static std::string textOf(const char* format, std::initializer_list<WLOArgument> arguments) {
    systemLog().clearMessages();
    WLOLog(3, format, arguments);
    const auto messages = systemLog().messages();
    return messages.size() == 1 ? messages[0].at("Message") : "not one message";
  }
};

TEST_F(WLOLogTest, ExportsTheKeyOfTheLevel) { EXPECT_STREQ(kWLOLogLevelKey, "NidusLogLevel"); }

TEST_F(WLOLogTest, FirstTestOpensTheLog) {
  inFreshProcess([] {
    EXPECT_THAT(systemLog().openings(), IsEmpty());
    EXPECT_TRUE(WLOShouldLogAtLevel(4));
    const auto openings = systemLog().openings();
    ASSERT_EQ(openings.size(), 1U);
    EXPECT_FALSE(openings[0].identity);
    EXPECT_EQ(openings[0].facility, "com.corvane.Nidus");
    EXPECT_EQ(openings[0].options, 0U);
    EXPECT_EQ(platform().testPreferences().synchronizations(), 1U);
  });
}

TEST_F(WLOLogTest, FirstMessageOpensTheLogToo) {
  inFreshProcess([] {
    WLOLog(4, "hello", {});
    EXPECT_EQ(systemLog().openings().size(), 1U);
    EXPECT_THAT(systemLog().lines(), ElementsAre("4 hello"));
  });
}

TEST_F(WLOLogTest, LogOpensOnce) {
  inFreshProcess([] {
    for (int i = 0; i < 3; ++i) {
      EXPECT_TRUE(WLOShouldLogAtLevel(0));
      WLOLog(4, "hello", {});
    }
    EXPECT_EQ(systemLog().openings().size(), 1U);
    EXPECT_EQ(platform().testNotifications().registrations().size(), 1U);
    EXPECT_EQ(platform().testPreferences().synchronizations(), 1U);
  });
}

TEST_F(WLOLogTest, ChangesAreHeardOnTheSharedQueue) {
  inFreshProcess([] {
    EXPECT_TRUE(WLOShouldLogAtLevel(0));
    const auto& registration = platform().testNotifications().registrations().at(0);
    EXPECT_EQ(registration.name, "com.corvane.managedconfiguration.defaultsdidchange");
    EXPECT_EQ(registration.queue, platform().sharedQueue());
  });
}

TEST_F(WLOLogTest, ManyThreadsOpenTheLogOnce) {
  inFreshProcess([] {
    onManyThreads([] {
      if (WLOShouldLogAtLevel(4)) WLOLog(4, "hello", {});
    });
    EXPECT_EQ(systemLog().openings().size(), 1U);
    EXPECT_EQ(systemLog().messages().size(), kThreadCount);
  });
}

TEST_F(WLOLogTest, OneOfManyReadersSetsTheFilter) {
  inFreshProcess([] {
    EXPECT_EQ(threshold(), 4);
    setPreference(kWLOLogLevelKey, 7);
    onManyThreads(&notifyOfChange);
    EXPECT_EQ(threshold(), 7);
    EXPECT_THAT(systemLog().filterMasks(), ElementsAre(0x1F, 0xFF));
  });
}

/// What is set before the log opens, and what follows.
struct LevelCase {
  const char* label;
  std::int64_t level;
  std::int64_t developerLevel;
  NDValueRef internalBuild;
  int threshold;
  std::uint32_t mask;
};

void PrintTo(const LevelCase& each, std::ostream* out) { *out << each.label; }

class LevelTest : public WLOLogTest, public ::testing::WithParamInterface<LevelCase> {};

TEST_P(LevelTest, FollowsFromPreferencesAndBuild) {
  inFreshProcess([] {
    setPreference(kWLOLogLevelKey, GetParam().level);
    setPreference(kDeveloperLevelKey, GetParam().developerLevel);
    platform().setInternalBuild(GetParam().internalBuild);
    EXPECT_EQ(threshold(), GetParam().threshold);
    EXPECT_THAT(systemLog().filterMasks(), ElementsAre(GetParam().mask));
  });
}

const NDValueRef kCustomer = NDValue::boolean(false);
const NDValueRef kInternal = NDValue::boolean(true);
constexpr std::int64_t kTwoTo32 = std::int64_t{1} << 32;

INSTANTIATE_TEST_SUITE_P(
    Levels, LevelTest,
    ::testing::Values(LevelCase{"NoPreferences", 0, 0, nullptr, 4, 0x1F},
                      LevelCase{"CustomerBuild", 0, 0, kCustomer, 4, 0x1F},
                      LevelCase{"InternalBuild", 0, 0, kInternal, 6, 0x7F},
                      LevelCase{"NumberIsNoBuildKind", 0, 0, NDValue::integer(1), 4, 0x1F},
                      LevelCase{"TextIsNoBuildKind", 0, 0, NDValue::text("true"), 4, 0x1F},
                      LevelCase{"LevelBelowRange", 2, 0, kCustomer, 4, 0x1F},
                      LevelCase{"LevelNegative", -5, 0, kCustomer, 4, 0x1F},
                      LevelCase{"LevelThree", 3, 0, kCustomer, 3, 0xF},
                      LevelCase{"LevelThreeOnInternalBuild", 3, 7, kInternal, 3, 0xF},
                      LevelCase{"LevelSeven", 7, 0, kCustomer, 7, 0xFF},
                      LevelCase{"LevelNine", 9, 0, kCustomer, 9, 0x3FF},
                      LevelCase{"LevelThirty", 30, 0, kCustomer, 30, 0x7FFFFFFF},
                      LevelCase{"LevelThirtyOne", 31, 0, kCustomer, 31, 0xFFFFFFFF},
                      LevelCase{"LevelHuge", kTwoTo32, 0, kCustomer, 31, 0xFFFFFFFF},
                      LevelCase{"DeveloperSeven", 2, 7, kCustomer, 7, 0xFF},
                      LevelCase{"DeveloperEight", 2, 8, kCustomer, 4, 0x1F},
                      LevelCase{"DeveloperEightInternal", 2, 8, kInternal, 6, 0x7F},
                      LevelCase{"DeveloperFive", 0, 5, kCustomer, 5, 0x3F},
                      LevelCase{"DeveloperFour", 0, 4, kCustomer, 4, 0x1F},
                      LevelCase{"DeveloperBelowFloor", 0, 3, kCustomer, 4, 0x1F},
                      LevelCase{"DeveloperBelowInternalFloor", 0, 5, kInternal, 6, 0x7F},
                      LevelCase{"DeveloperNegative", 0, -1, kCustomer, 4, 0x1F}),
    [](const auto& test) { return std::string(test.param.label); });

TEST_F(WLOLogTest, ChangedPreferencesChangeTheLevel) {
  inFreshProcess([] {
    EXPECT_EQ(threshold(), 4);
    setPreference(kWLOLogLevelKey, 7);
    EXPECT_EQ(threshold(), 4);
    notifyOfChange();
    EXPECT_EQ(threshold(), 7);
    EXPECT_THAT(systemLog().filterMasks(), ElementsAre(0x1F, 0xFF));
  });
}

TEST_F(WLOLogTest, UnchangedPreferencesLeaveTheFilterAlone) {
  inFreshProcess([] {
    EXPECT_EQ(threshold(), 4);
    notifyOfChange();
    notifyOfChange();
    EXPECT_EQ(platform().testPreferences().synchronizations(), 3U);
    EXPECT_THAT(systemLog().filterMasks(), ElementsAre(0x1F));
  });
}

TEST_F(WLOLogTest, BuildIsAskedForOnce) {
  inFreshProcess([] {
    platform().setInternalBuild(kInternal);
    EXPECT_EQ(threshold(), 6);
    platform().setInternalBuild(kCustomer);
    notifyOfChange();
    EXPECT_EQ(threshold(), 6);
    EXPECT_EQ(platform().deviceQueries(), 1U);
  });
}

TEST_F(WLOLogTest, MessageHasLevelFacilityAndText) {
  inFreshProcess([] {
    WLOLog(5, "hello", {});
    EXPECT_THAT(systemLog().messages(),
                ElementsAre(UnorderedElementsAre(Pair("Level", "5"), Pair("Message", "hello"),
                                                 Pair("Facility", "com.corvane.Nidus"))));
  });
}

TEST_F(WLOLogTest, EachLevelHasItsName) {
  inFreshProcess([] {
    for (int level = 0; level <= 7; ++level) WLOLog(level, "x", {});
    EXPECT_THAT(systemLog().lines(),
                ElementsAre("0 x", "1 x", "2 x", "3 x", "4 x", "5 x", "6 x", "7 x"));
  });
}

#ifndef NDEBUG
using WLOLogDeathTest = WLOLogTest;

TEST_F(WLOLogDeathTest, LevelsWithoutNameStopTheProcess) {
  GTEST_FLAG_SET(death_test_style, "threadsafe");
  EXPECT_DEATH(WLOLog(-1, "x", {}), "level >= 0 && level <= 7");
  EXPECT_DEATH(WLOLog(8, "x", {}), "level >= 0 && level <= 7");
}
#endif

TEST_F(WLOLogTest, MissingFormatLeavesTheTextOut) {
  inFreshProcess([] {
    WLOLog(3, nullptr, {});
    ASSERT_EQ(systemLog().messages().size(), 1U);
    EXPECT_THAT(systemLog().messages()[0],
                AllOf(Contains(Pair("Level", "3")), Not(Contains(Pair("Message", ::testing::_)))));
  });
}

TEST_F(WLOLogTest, RefusedMessageIsDropped) {
  inFreshProcess([] {
    systemLog().refuseMessages();
    WLOLog(3, "hello", {});
    EXPECT_THAT(systemLog().messages(), IsEmpty());
  });
}

TEST_F(WLOLogTest, ArgumentsTakeTheirPlaces) {
  inFreshProcess([] {
    const NDString text("Lamp");
    const NDString null;
    EXPECT_EQ(textOf("%s ### %@.", {"operation", text}), "operation ### Lamp.");
    EXPECT_EQ(textOf("%@ %@ %@", {std::string("a"), std::string_view("b"), null}), "a b (null)");
    EXPECT_EQ(textOf("%@ %@", {-7, std::uint32_t{8}}), "-7 8");
    EXPECT_EQ(textOf("%@", {Lamp()}), "a lamp");
  });
}

TEST_F(WLOLogTest, PercentSignsAreKept) {
  inFreshProcess([] {
    EXPECT_EQ(textOf("100%% %d %", {}), "100% %d %");
    EXPECT_EQ(textOf("%%@ %@", {"x"}), "%@ x");
    EXPECT_EQ(textOf("%@ %@", {"%@"}), "%@ %@");
    EXPECT_EQ(textOf("", {"x"}), "");
  });
}

TEST_F(WLOLogTest, MessageTakesAListOfArguments) {
  inFreshProcess([] {
    const std::vector<WLOArgument> arguments = {"Lamp", 4};
    WLOLogV(4, "%@ has %@", arguments);
    EXPECT_THAT(systemLog().lines(), ElementsAre("4 Lamp has 4"));
  });
}

TEST_F(WLOLogTest, WithoutMemoryNothingIsLogged) {
#ifdef __SANITIZE_THREAD__
  GTEST_SKIP() << "an exception out of std::call_once is more than the thread sanitizer knows";
#endif
  inFreshProcess([] {
    systemLog().exhaustMemory(true);
    EXPECT_FALSE(WLOShouldLogAtLevel(0));
    EXPECT_NO_THROW(WLOLog(0, "lost", {}));
    systemLog().exhaustMemory(false);
    EXPECT_TRUE(WLOShouldLogAtLevel(0));
    WLOLog(0, "heard", {});
    EXPECT_THAT(systemLog().lines(), ElementsAre("0 heard"));
  });
}

TEST_F(WLOLogTest, LevelStaysAfterThePlatform) {
  inFreshProcess([] {
    EXPECT_EQ(threshold(), 4);
    NDPlatform::unregisterPlatform(TestPlatform::shared());
    setPreference(kWLOLogLevelKey, 7);
    notifyOfChange();
    EXPECT_EQ(threshold(), 4);
    EXPECT_EQ(platform().testPreferences().synchronizations(), 1U);
  });
}

TEST_F(WLOLogTest, WithoutPlatformNothingIsLogged) {
  inFreshProcess([] {
    NDPlatform::unregisterPlatform(TestPlatform::shared());
    EXPECT_FALSE(WLOShouldLogAtLevel(0));
    WLOLog(0, "lost", {});
    EXPECT_EQ(NDPlatform::registerPlatform(TestPlatform::shared()), "");
    EXPECT_TRUE(WLOShouldLogAtLevel(0));
    WLOLog(0, "heard", {});
    EXPECT_THAT(systemLog().lines(), ElementsAre("0 heard"));
  });
}

}  // namespace
}  // namespace nidus
