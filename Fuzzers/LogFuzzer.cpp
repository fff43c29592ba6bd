#include <fuzzer/FuzzedDataProvider.h>
#include <sys/socket.h>
#include <sys/un.h>

#include <algorithm>
#include <array>
#include <cstring>
#include <deque>
#include <memory>
#include <optional>
#include <vector>

#include "AssistantHost/RegisteredPlatform.h"
#include "HomePlatform/System/FileDescriptor.h"
#include "HomePlatform/System/LogOutput.h"
#include "Logging/WLOLog.h"
#include "PlatformModel/Assistant/VAHAValue.h"
#include "Support/Finding.h"
#include "Support/TestFolder.h"

// The log: any format with any arguments becomes the text that it says, one line for people, and
// one datagram of whole fields for the journal.

namespace nidus {
namespace {

NDSystemLogMessage lastMessage;

/// The platform whose log passes each message on to `lastMessage`; opened once.
void registerPlatform() {
  static const auto kRegistered = [] {
    HomePlatformOptions options;
    options.drainsOnCaller = true;
    options.preferences = {{"NidusLogLevel", {std::int64_t{7}}}};
    options.logSink = [](const NDSystemLogMessage& message) { lastMessage = message; };
    return RegisteredPlatform::open(std::move(options));
  }();
  if (!kRegistered) reportFinding(kRegistered.failure().message);
}

/// A journal of our own, and the log that writes to it.
class Journal {
 public:
  Journal() : socket_(::socket(AF_UNIX, SOCK_DGRAM | SOCK_CLOEXEC, 0)) {
    sockaddr_un address = {};
    address.sun_family = AF_UNIX;
    const std::string path = folder_.file("journal");
    std::memcpy(address.sun_path, path.c_str(), path.size());
    const auto* generic = reinterpret_cast<const sockaddr*>(&address);
    if (::bind(socket_.get(), generic, sizeof address) != 0) reportFinding("There is no journal.");
    log_ = makeSystemLog(path);
  }

  /// The fields of `message` as they arrive, in order.
  std::vector<std::pair<std::string, std::string>> send(const NDSystemLogMessage& message) {
    log_->write(message);
    std::array<char, 65536> datagram{};
    const ssize_t size = ::recv(socket_.get(), datagram.data(), datagram.size(), MSG_DONTWAIT);
    if (size < 0) reportFinding("A message does not arrive at the journal.");
    return fieldsOf({datagram.data(), static_cast<std::size_t>(size)});
  }

 private:
  /// Each field is its name and a line end, eight bytes of length from the lowest, and as many
  /// bytes of text with a line end.
  static std::vector<std::pair<std::string, std::string>> fieldsOf(std::string_view datagram) {
    std::vector<std::pair<std::string, std::string>> fields;
    while (!datagram.empty()) {
      const std::size_t end = datagram.find('\n');
      if (end == std::string_view::npos || datagram.size() < end + 10) {
        reportFinding("A datagram ends within a field.");
      }
      std::size_t size = 0;
      for (std::size_t byte = 8; byte > 0; --byte) {
        size = size << 8U | static_cast<unsigned char>(datagram[end + byte]);
      }
      fields.emplace_back(datagram.substr(0, end), datagram.substr(end + 9, size));
      datagram.remove_prefix(std::min(end + 9 + size + 1, datagram.size()));
    }
    return fields;
  }

  const TestFolder folder_;
  const FileDescriptor socket_;
  std::unique_ptr<LogOutput> log_;
};

/// Arguments and what each of them reads as.
struct Arguments {
  std::vector<WLOArgument> list;
  std::vector<std::string> texts;
  std::deque<std::string> strings;
  std::deque<NDString> shared;
  std::deque<VAHAValueRef> values;

  void take(FuzzedDataProvider& input);

 private:
  void takeValue(FuzzedDataProvider& input);
};

void Arguments::takeValue(FuzzedDataProvider& input) {
  if (input.ConsumeBool()) {
    texts.emplace_back("(null)");
    values.emplace_back();
  } else {
    auto value = VAHAIntegerValue::integerValue();
    value->setValue(input.ConsumeIntegral<std::int64_t>());
    texts.push_back(std::to_string(value->value()));
    values.push_back(std::move(value));
  }
  list.emplace_back(values.back());
}

void Arguments::take(FuzzedDataProvider& input) {
  switch (input.ConsumeIntegralInRange(0, 4)) {
    case 0:
      strings.push_back(input.ConsumeRandomLengthString(20));
      texts.push_back(strings.back());
      list.emplace_back(strings.back());
      break;
    case 1:
      strings.push_back(input.ConsumeRandomLengthString(20));
      texts.emplace_back(strings.back().c_str());  // up to the first zero byte
      list.emplace_back(strings.back().c_str());
      break;
    case 2:
      shared.push_back(input.ConsumeBool() ? NDString(input.ConsumeRandomLengthString(20))
                                           : NDString());
      texts.push_back(shared.back() ? shared.back().str() : "(null)");
      list.emplace_back(shared.back());
      break;
    case 3:
      texts.push_back(std::to_string(input.ConsumeIntegral<std::int32_t>()));
      list.emplace_back(std::stoll(texts.back()));
      break;
    default:
      takeValue(input);
  }
}

/// The place of the next "%@" or "%s" from `from` on that no "%%" eats into.
std::size_t nextPlace(std::string_view format, std::size_t from) {
  for (std::size_t at = format.find('%', from); at != std::string_view::npos;
       at = format.find('%', at + 1)) {
    const std::string_view pair = format.substr(at, 2);
    if (pair == "%@" || pair == "%s") return at;
    if (pair == "%%") ++at;
  }
  return std::string_view::npos;
}

std::string withoutDoubledPercents(std::string_view part) {
  std::string text(part);
  for (std::size_t at = text.find("%%"); at != std::string::npos; at = text.find("%%", at + 1)) {
    text.erase(at, 1);
  }
  return text;
}

std::string expectedText(std::string_view format, const std::vector<std::string>& arguments) {
  std::string text;
  std::size_t begin = 0;
  for (const std::string& argument : arguments) {
    const std::size_t place = nextPlace(format, begin);
    if (place == std::string_view::npos) break;
    text += withoutDoubledPercents(format.substr(begin, place - begin)) + argument;
    begin = place + 2;
  }
  return text + withoutDoubledPercents(format.substr(begin));
}

void checkLine(const NDSystemLogMessage& message) {
  const std::string line = logLine(message);
  const auto isControl = [](char c) {
    const auto code = static_cast<unsigned char>(c);
    return code < 0x20 || code == 0x7F;
  };
  if (line.empty() || line.back() != '\n' || std::any_of(line.begin(), line.end() - 1, isControl)) {
    reportFinding("A message is not one line: " + line);
  }
}

void checkJournal(const NDSystemLogMessage& message) {
  static Journal journal;
  const std::vector<std::pair<std::string, std::string>> expected = {
      {"MESSAGE", logField(message, "Message")},
      {"PRIORITY", logField(message, "Level")},
      {"NIDUS_FACILITY", "com.corvane.Nidus"},
      {"SYSLOG_IDENTIFIER", "nidus"}};
  if (journal.send(message) != expected) {
    reportFinding("The journal gets other fields: " + logLine(message));
  }
}

void tryMessage(FuzzedDataProvider& input) {
  registerPlatform();
  const int level = input.ConsumeIntegralInRange(0, 7);
  Arguments arguments;
  for (int count = input.ConsumeIntegralInRange(0, 4); count > 0; --count) arguments.take(input);
  const std::string format = input.ConsumeRemainingBytesAsString();
  if (!WLOShouldLogAtLevel(level))
    reportFinding("A level is held back that the preference lets through.");
  lastMessage = {};
  WLOLogV(level, format.c_str(), arguments.list);
  expectSameText("The level", std::to_string(level), logField(lastMessage, "Level"));
  expectSameText("The message", expectedText(format.c_str(), arguments.texts),
                 logField(lastMessage, "Message"));
  checkLine(lastMessage);
  checkJournal(lastMessage);
}

}  // namespace
}  // namespace nidus

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  FuzzedDataProvider input(data, size);
  nidus::tryMessage(input);
  return 0;
}
