#include "HomePlatform/System/LogService.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <sys/socket.h>
#include <sys/un.h>

#include <cstring>

#include "HomePlatform/System/FileDescriptor.h"
#include "Support/FileShortage.h"
#include "Support/TestFolder.h"

namespace nidus {
namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

NDSystemLogMessage message(std::string_view level, std::string_view text) {
  NDSystemLogMessage made;
  made.set("Level", level);
  made.set("Facility", "com.corvane.Nidus");
  made.set("Message", text);
  return made;
}

class LogServiceTest : public testing::Test {
 protected:
  void send(std::string_view level, std::string_view text) { client_->send(message(level, text)); }

  std::vector<std::string> texts_;
  LogService service_{[this](const auto& sent) { texts_.push_back(logField(sent, "Message")); }};
  const std::shared_ptr<NDSystemLogClient> client_ =
      service_.openClient(nullptr, "com.corvane.Nidus", 0);
};

TEST_F(LogServiceTest, PassesEverythingAtFirst) {
  for (const char* level : {"0", "7"}) send(level, level);
  EXPECT_THAT(texts_, ElementsAre("0", "7"));
}

TEST_F(LogServiceTest, FilterPassesItsSeverities) {
  client_->setFilterMask(0b10010U);
  for (const char* level : {"0", "1", "3", "4", "5"}) send(level, level);
  EXPECT_THAT(texts_, ElementsAre("1", "4"));
}

TEST_F(LogServiceTest, FilterCanBeOpenedAgain) {
  client_->setFilterMask(0);
  send("3", "held back");
  client_->setFilterMask(~std::uint32_t{0});
  send("3", "passed");
  EXPECT_THAT(texts_, ElementsAre("passed"));
}

TEST_F(LogServiceTest, EachClientHasItsFilter) {
  client_->setFilterMask(0);
  service_.openClient(nullptr, "other", 0)->send(message("3", "other"));
  EXPECT_THAT(texts_, ElementsAre("other"));
}

TEST_F(LogServiceTest, UnknownLevelPassesAnyFilter) {
  client_->setFilterMask(0);
  send("12", "odd");
  EXPECT_THAT(texts_, ElementsAre("odd"));
}

TEST_F(LogServiceTest, MakesEmptyMessages) {
  const auto made = service_.createMessage();
  ASSERT_TRUE(made);
  EXPECT_THAT(made->fields(), IsEmpty());
}

TEST(LogLineTest, NamesLevelAndFacility) {
  EXPECT_EQ(logLine(message("3", "hello")), "error (3) com.corvane.Nidus: hello\n");
  EXPECT_EQ(logLine(message("7", "é")), "debug (7) com.corvane.Nidus: é\n");
}

TEST(LogLineTest, NoTextMakesLines) {
  EXPECT_EQ(logLine(message("4", "a\nerror (3) x\r\x1b[1m\x7f\xc2\x9b")),
            "warning (4) com.corvane.Nidus: a\\x0aerror (3) x\\x0d\\x1b[1m\\x7f\\xc2\\x9b\n");
}

TEST(LogLineTest, MissingFieldsAreEmpty) {
  EXPECT_EQ(logLine(NDSystemLogMessage()), "debug (7) : \n");
}

TEST(StandardErrorLogTest, WritesOneLine) {
  testing::internal::CaptureStderr();
  makeStandardErrorLog()->write(message("6", "hello"));
  EXPECT_EQ(testing::internal::GetCapturedStderr(), "info (6) com.corvane.Nidus: hello\n");
}

/// A journal that the test reads.
class JournalTest : public testing::Test {
 protected:
  JournalTest() : socket_(::socket(AF_UNIX, SOCK_DGRAM | SOCK_CLOEXEC, 0)) {
    sockaddr_un address = {};
    address.sun_family = AF_UNIX;
    std::strncpy(address.sun_path, path_.c_str(), sizeof address.sun_path - 1);
    const auto* const name = reinterpret_cast<const sockaddr*>(&address);
    EXPECT_EQ(::bind(socket_.get(), name, sizeof address), 0);
  }
  [[nodiscard]] std::string receive() const {
    char datagram[4096];
    const ssize_t size = ::recv(socket_.get(), datagram, sizeof datagram, 0);
    return {datagram, static_cast<std::size_t>(size < 0 ? 0 : size)};
  }
  [[nodiscard]] static std::string field(const std::string& name, const std::string& text) {
    return name + '\n' + static_cast<char>(text.size()) + std::string(7, '\0') + text + '\n';
  }

  const TestFolder folder_;
  const std::string path_ = folder_.file("journal");
  const FileDescriptor socket_;
};

TEST_F(JournalTest, TakesLevelFacilityAndText) {
  const auto log = makeSystemLog(path_);
  ASSERT_TRUE(log);
  log->write(message("4", "two\nlines"));
  const std::string datagram = receive();
  EXPECT_THAT(datagram, HasSubstr(field("MESSAGE", "two\nlines")));
  EXPECT_THAT(datagram, HasSubstr(field("PRIORITY", "4")));
  EXPECT_THAT(datagram, HasSubstr(field("NIDUS_FACILITY", "com.corvane.Nidus")));
}

TEST_F(JournalTest, TakesTheLevelOfDebugForNone) {
  makeSystemLog(path_)->write(NDSystemLogMessage());
  EXPECT_THAT(receive(), HasSubstr(field("PRIORITY", "7")));
}

/// The machine may have a log of the older kind, which is then used instead.
bool isAnOlderLogThere() { return ::access("/dev/log", W_OK) == 0; }

TEST_F(JournalTest, IsOptional) {
  const std::string tooLong(200, 'x');
  for (const std::string& path : {folder_.file("missing"), folder_.file(tooLong)}) {
    EXPECT_EQ(makeSystemLog(path) != nullptr, isAnOlderLogThere()) << path;
  }
}

TEST_F(JournalTest, IsLeftOutWhenNoFileIsLeft) {
  const FileShortage shortage;
  EXPECT_EQ(makeSystemLog(path_) != nullptr, isAnOlderLogThere());
}

}  // namespace
}  // namespace nidus
