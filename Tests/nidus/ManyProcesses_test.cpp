#include <algorithm>
#include <atomic>
#include <chrono>
#include <cstdlib>
#include <filesystem>
#include <mutex>
#include <thread>

#include "HomePlatform/Store/HomeStore.h"
#include "Support/ReportedCount.h"
#include "nidus/ProgramTest.h"

namespace nidus {
namespace {

using Clock = std::chrono::steady_clock;

constexpr int kProcesses = 8;

constexpr int kShortRounds = 40;
constexpr std::chrono::minutes kLongTime(1);

std::int64_t millisecondsOf(Clock::duration duration) {
  return std::chrono::duration_cast<std::chrono::milliseconds>(duration).count();
}

std::string lampName(int number) { return "Lamp " + std::to_string(number); }

std::string lamp(int number) {
  const std::string digit = std::to_string(number);
  return R"({"uuid": "DD00DD00-0000-4000-8000-00000000000)" + digit + R"(", "name": "Lamp )" +
         digit + R"(", "services": [{"instanceID": 8, "name": "Lamp )" + digit +
         R"(", "serviceType": "com.corvane.nidus.service.light", "characteristics": [
             {"instanceID": 9, "characteristicType": "com.corvane.nidus.characteristic.power",
              "properties": ["readable", "writable"], "value": false,
              "metadata": {"format": "bool"}},
             {"instanceID": 10, "characteristicType": "com.corvane.nidus.characteristic.brightness",
              "properties": ["readable", "writable"], "value": 0, "metadata": {"format": "int"}}
           ]}]})";
}

std::string homeOfLamps() {
  std::string home =
      R"({"uuid": "AA00AA00-0000-4000-8000-000000000001", "name": "Cottage", "primary": true,
      "accessories": [)";
  for (int i = 0; i < kProcesses; ++i) home += (i > 0 ? "," : "") + lamp(i);
  return home + "]}";
}

std::string commandLine(int number, const std::string& action) {
  return R"({"filter": {"search": {"serviceName": ")" + lampName(number) + R"("}}, "actions": [)" +
         action + "]}\n";
}

/// One process that sets, toggles and reads a lamp of its own, and a look into the database after
/// each answer.
class LampUser {
 public:
  LampUser(const ProgramStart& start, std::string database, int number)
      : process_(start), store_(std::move(*HomeStore::open(database))), number_(number) {}

  void useLamp(int round) {
    const std::string level = std::to_string(round + 1);
    perform(R"({"actionType": "SET", "attribute": "BRIGHTNESS", "value": {"integer": )" + level +
            "}}");
    EXPECT_EQ(stored(1), level);
    perform(R"({"actionType": "TOGGLE", "attribute": "POWER"})");
    EXPECT_EQ(stored(0), round % 2 == 0 ? "1" : "0");
    const std::string reply = perform(R"({"actionType": "GET", "attribute": "BRIGHTNESS"})");
    EXPECT_THAT(reply, testing::HasSubstr("{\"integer\": " + level + ","));
  }

  void finish() {
    const ProgramEnd end = process_.finish();
    EXPECT_EQ(end.exitStatus, 0);
    EXPECT_EQ(end.errors, "");
  }

  [[nodiscard]] Clock::duration longestWait() const { return longestWait_; }

 private:
  std::string perform(const std::string& action) {
    const auto begin = Clock::now();
    process_.write(commandLine(number_, action));
    std::string reply = process_.readLine().value_or("no reply");
    longestWait_ = std::max(longestWait_, Clock::now() - begin);
    EXPECT_THAT(reply, testing::HasSubstr("COMMAND_SUCCESS"));
    EXPECT_THAT(reply, testing::HasSubstr(R"("outcome": "SUCCESS")"));
    return reply;
  }

  /// The value of a characteristic of the lamp as the database has it at this moment.
  std::string stored(std::size_t characteristic) {
    const auto homes = store_->loadHomes();
    if (!homes) return homes.failure().message;
    const auto index = static_cast<std::size_t>(number_);
    const auto& service = homes->at(0).accessories.at(index).services.at(0);
    return description(service.characteristics.at(characteristic).value);
  }

  ProgramProcess process_;
  const std::unique_ptr<HomeStore> store_;
  const int number_;
  Clock::duration longestWait_{};
};

class ManyProcessesTest : public ProgramTest {
 protected:
  void useLamps(int number) {
    LampUser user(start({"perform"}), data() + "/home.db", number);
    int round = 0;
    for (; goesOn(round) && !HasFailure(); ++round) user.useLamp(round);
    user.finish();
    const std::lock_guard<std::mutex> lock(mutex_);
    rounds_ += round;
    longestWait_ = std::max(longestWait_, user.longestWait());
    if (++finished_ == kProcesses) areDone_.store(true);
  }

  /// Whether a process does one more round: so many, or in the long form for so long.
  [[nodiscard]] bool goesOn(int round) const {
    return isLong_ ? Clock::now() - begin_ < kLongTime : round < kShortRounds;
  }

  /// Imports another home beside that of the lamps, over and over.
  void importMeanwhile() {
    const std::string file = folder_.write("other.json", documentOf({emptyHome("Other", 2)}));
    do {
      const ProgramEnd end = run({"home", "import", "--merge", file});
      EXPECT_EQ(end.exitStatus, 0) << end.errors;
      ++imports_;
    } while (!areDone_.load());
  }

  const bool isLong_ = std::getenv("NIDUS_EVERY_FAULT") != nullptr;
  const Clock::time_point begin_ = Clock::now();
  std::mutex mutex_;
  std::int64_t rounds_ = 0;
  Clock::duration longestWait_{};
  int finished_ = 0;
  int imports_ = 0;
  std::atomic<bool> areDone_{false};
};

TEST_F(ManyProcessesTest, LoseNothingThatWasAnswered) {
  import(documentOf({homeOfLamps()}));
  std::vector<std::thread> threads;
  threads.reserve(kProcesses);
  for (int i = 0; i < kProcesses; ++i) {
    threads.emplace_back([this, i] { useLamps(i); });
  }
  importMeanwhile();
  for (std::thread& thread : threads) thread.join();
  reportCount("longest wait in ms", millisecondsOf(longestWait_));
  reportCount("commands", rounds_ * 3);
  reportCount("imports", imports_);
  EXPECT_GT(imports_, 1);
}

}  // namespace
}  // namespace nidus
