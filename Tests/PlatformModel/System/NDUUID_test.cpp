#include "PlatformModel/System/NDUUID.h"

#include <gtest/gtest.h>
#include <sys/wait.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <optional>
#include <set>
#include <string>
#include <system_error>
#include <thread>
#include <unordered_set>
#include <vector>

#include "PlatformModel/RunOnThreads.h"
#include "PlatformModel/Support/FaultyRandomSource.h"

namespace nidus {
namespace {

constexpr const char* kCanonical = "9E01A3C4-00FF-4000-8000-00000000000B";

TEST(NDUUIDTest, ReadsEitherLetterCase) {
  const auto upper = NDUUID::fromText(kCanonical);
  const auto lower = NDUUID::fromText("9e01a3c4-00ff-4000-8000-00000000000b");
  ASSERT_TRUE(upper);
  EXPECT_EQ(upper, lower);
  EXPECT_EQ(upper->bytes()[0], 0x9E);
  EXPECT_EQ(upper->bytes()[15], 0x0B);
}

TEST(NDUUIDTest, WritesTheCanonicalText) {
  EXPECT_EQ(NDUUID::fromText(kCanonical)->UUIDString(), kCanonical);
  EXPECT_EQ(NDUUID().UUIDString(), "00000000-0000-0000-0000-000000000000");
}

TEST(NDUUIDTest, WriteTextFillsExactlyItsLength) {
  std::string text(NDUUID::kTextLength + 1, '?');
  NDUUID::fromText(kCanonical)->writeText(text.data());
  EXPECT_EQ(text, std::string(kCanonical) + '?');
}

TEST(NDUUIDTest, RefusesAnyOtherForm) {
  const std::vector<std::string> malformed = {
      "",
      "9E01A3C4-00FF-4000-8000-00000000000",
      "9E01A3C4-00FF-4000-8000-00000000000B0",
      "9E01A3C4000FF-4000-8000-00000000000B",
      "9E01A3C4-00FF-4000-8000-00000000000G",
      "-9E01A3C-400FF-4000-8000-0000000000B",
      "9E01A3C400FF40008000000000000000000B",
      "9E01A3C4 00FF-4000-8000-00000000000B",
      " 9E01A3C4-00FF-4000-8000-0000000000B",
      "{E01A3C4-00FF-4000-8000-0000000000B}",
  };
  for (const std::string& text : malformed) EXPECT_FALSE(NDUUID::fromText(text)) << text;
}

TEST(NDUUIDTest, RandomOnesAreOfVersionFour) {
  for (int i = 0; i < 100; ++i) {
    const NDUUID uuid = NDUUID::random();
    EXPECT_EQ(uuid.bytes()[6] >> 4, 4);
    EXPECT_EQ(uuid.bytes()[8] >> 6, 2);
  }
}

TEST(NDUUIDTest, RandomBitsAllVary) {
  std::array<std::uint8_t, 16> everSet{};
  std::array<std::uint8_t, 16> everClear{};
  for (int i = 0; i < 200; ++i) {
    const auto bytes = NDUUID::random().bytes();
    for (std::size_t at = 0; at < bytes.size(); ++at) {
      everSet[at] |= bytes[at];
      everClear[at] |= static_cast<std::uint8_t>(~bytes[at]);
    }
  }
  for (std::size_t at = 0; at < everSet.size(); ++at) {
    const int fixed = at == 6 ? 0xF0 : at == 8 ? 0xC0 : 0;
    EXPECT_EQ((everSet[at] & everClear[at]) | fixed, 0xFF) << at;
  }
}

TEST(NDUUIDTest, ThreadsNeverShareRandomOnes) {
  constexpr std::size_t kThreads = 4;
  constexpr std::size_t kEach = 500;
  std::vector<std::vector<NDUUID>> made(kThreads);
  runOnThreads(kThreads, [&made](std::size_t number) {
    for (std::size_t i = 0; i < kEach; ++i) made[number].push_back(NDUUID::random());
  });
  std::set<NDUUID> all;
  for (const auto& uuids : made) all.insert(uuids.begin(), uuids.end());
  EXPECT_EQ(all.size(), kThreads * kEach);
}

// Random bytes that were drawn before a fork are known to both processes.
TEST(NDUUIDTest, ForkedProcessMakesOthers) {
  static_cast<void>(NDUUID::random());
  std::array<int, 2> pipeEnds{};
  ASSERT_EQ(pipe(pipeEnds.data()), 0);
  const pid_t child = fork();
  ASSERT_GE(child, 0);
  const NDUUID mine = NDUUID::random();
  if (child == 0) {
    const bool isWritten = write(pipeEnds[1], mine.bytes().data(), 16) == 16;
    _exit(isWritten ? 0 : 1);
  }
  std::array<std::uint8_t, 16> bytes{};
  EXPECT_EQ(read(pipeEnds[0], bytes.data(), bytes.size()), 16);
  EXPECT_NE(NDUUID(bytes), mine);
  int status = 0;
  EXPECT_EQ(waitpid(child, &status, 0), child);
  EXPECT_EQ(status, 0);
  close(pipeEnds[0]);
  close(pipeEnds[1]);
}

/// Makes one on a thread of its own, which has no random bytes left from an earlier one.
std::optional<NDUUID> randomOfNewThread(std::error_code& failure) {
  std::optional<NDUUID> made;
  std::thread([&] {
    try {
      made = NDUUID::random();
    } catch (const std::system_error& error) {
      failure = error.code();
    }
  }).join();
  return made;
}

TEST(NDUUIDTest, InterruptedDrawIsMadeAgain) {
  const FaultyRandomSource source(EINTR, 2);
  std::error_code failure;
  const auto made = randomOfNewThread(failure);
  ASSERT_TRUE(made) << failure.message();
  EXPECT_EQ(FaultyRandomSource::drawsLeft(), 0);
  EXPECT_NE(made, randomOfNewThread(failure));
}

TEST(NDUUIDTest, WithoutRandomBytesNoneIsMade) {
  const FaultyRandomSource source(ENOSYS, 1);
  std::error_code failure;
  EXPECT_FALSE(randomOfNewThread(failure));
  EXPECT_EQ(failure, std::errc::function_not_supported);
}

TEST(NDUUIDTest, OrdersByBytes) {
  std::array<std::uint8_t, 16> bytes{};
  bytes[15] = 1;
  EXPECT_LT(NDUUID(), NDUUID(bytes));
  EXPECT_EQ(NDUUID(bytes), NDUUID(bytes));
}

TEST(NDUUIDTest, HashTellsNeighboursApart) {
  std::unordered_set<std::size_t> hashes;
  for (std::uint8_t last = 0; last < 255; ++last) {
    std::array<std::uint8_t, 16> bytes{};
    bytes[15] = last;
    hashes.insert(std::hash<NDUUID>{}(NDUUID(bytes)));
  }
  EXPECT_EQ(hashes.size(), 255U);
  EXPECT_EQ(std::hash<NDUUID>{}(NDUUID()), std::hash<NDUUID>{}(NDUUID()));
}

TEST(NDUUIDTest, HashTellsColludingUUIDsApart) {
  // Alike to hashes that add up bytes, halves or words.
  std::unordered_set<std::size_t> hashes;
  for (std::uint8_t i = 0; i < 100; ++i) {
    const auto j = static_cast<std::uint8_t>(100 - i);
    hashes.insert(std::hash<NDUUID>{}(NDUUID({i, 0, 0, 0, 0, 0, 0, 0, i})));
    hashes.insert(std::hash<NDUUID>{}(NDUUID({1, 0, i, 0, 0, 0, j, 0})));
  }
  hashes.insert(std::hash<NDUUID>{}(NDUUID({2, 0})));
  hashes.insert(std::hash<NDUUID>{}(NDUUID({1, 131})));
  EXPECT_EQ(hashes.size(), 202U);
}

}  // namespace
}  // namespace nidus
