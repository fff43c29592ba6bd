#include "Logging/WLOLog.h"

#include <array>
#include <atomic>
#include <cassert>
#include <memory>

#include "Logging/WLOThreshold.h"
#include "PlatformModel/NDPlatform.h"
#include "PlatformModel/System/NDRunOnce.h"

extern "C" {
const char kWLOLogLevelKey[] = "NidusLogLevel";
}

namespace nidus {
namespace {

constexpr std::array kLevelNames = {"0", "1", "2", "3", "4", "5", "6", "7"};

constexpr const char* kFacility = "com.corvane.Nidus";
constexpr const char* kPreferencesDidChange = "com.corvane.managedconfiguration.defaultsdidchange";

/// What stays open for the life of the process. Never destroyed: threads may log to the very end.
struct Connection {
  std::shared_ptr<NDSystemLogClient> client;
  std::shared_ptr<NDNotificationCenter::Token> changeRegistration;
};

constinit std::atomic<std::int32_t> currentLevel{0};
constinit Connection* connection = nullptr;
constinit NDRunOnce connectOnce;

/// Lets all severities up to `level` pass.
std::uint32_t maskUpTo(std::int32_t level) {
  return level >= 31 ? ~std::uint32_t{0} : (std::uint32_t{1} << (level + 1)) - 1;
}

/// Takes the level from the preferences. The filter is set by whoever changes the level, so that
/// the two agree in the end.
void readLevel() {
  const auto platform = NDPlatform::registered();
  if (!platform) return;
  const std::int32_t level = readThreshold(*platform).level;
  std::int32_t known = currentLevel.load();
  if (level == known) return;
  if (currentLevel.compare_exchange_strong(known, level)) {
    connection->client->setFilterMask(maskUpTo(level));
  }
}

void connect(NDPlatform& platform) {
  if (!connection) connection = new Connection;
  connection->client = platform.systemLog()->openClient(nullptr, kFacility, 0);
  readLevel();
  connection->changeRegistration = platform.notificationCenter()->registerForName_queue_handler(
      kPreferencesDidChange, platform.sharedQueue(), [] { readLevel(); });
}

/// Connects on first use. Without a platform there is no log yet, and the next use asks again.
bool isConnected() {
  if (connectOnce.hasRun()) return true;
  const auto platform = NDPlatform::registered();
  if (!platform) return false;
  connectOnce.run([&platform] { connect(*platform); });
  return true;
}

bool isPlace(std::string_view format) {
  return format.starts_with("%@") || format.starts_with("%s");
}

/// Puts the arguments in the places of "%@" and "%s"; a place without an argument stays as it is.
std::string formatted(std::string_view format, std::span<const WLOArgument> arguments) {
  std::string text;
  auto argument = arguments.begin();
  while (!format.empty()) {
    std::size_t length = 2;
    if (format.starts_with("%%")) {
      text += '%';
    } else if (isPlace(format) && argument != arguments.end()) {
      (argument++)->appendTo(text);
    } else {
      text += format.front();
      length = 1;
    }
    format.remove_prefix(length);
  }
  return text;
}

}  // namespace

void WLOArgument::appendTo(std::string& out) const {
  if (const auto* text = std::get_if<std::string_view>(&content_)) {
    out += *text;
  } else if (const auto* shared = std::get_if<const NDString*>(&content_)) {
    out += **shared ? (*shared)->view() : "(null)";
  } else if (const auto* number = std::get_if<std::int64_t>(&content_)) {
    out += std::to_string(*number);
  } else {
    const auto& reference = std::get<Reference>(content_);
    out += reference.describe(reference.object);
  }
}

}  // namespace nidus

// A host's logging must not end the host: what cannot be logged, for want of memory, is not logged.

bool WLOShouldLogAtLevel(int level) try {
  return nidus::isConnected() && level <= nidus::currentLevel.load(std::memory_order_relaxed);
} catch (...) {
  return false;
}

void WLOLog(int level, const char* format, std::initializer_list<nidus::WLOArgument> arguments) {
  WLOLogV(level, format, {arguments.begin(), arguments.size()});
}

void WLOLogV(int level, const char* format, std::span<const nidus::WLOArgument> arguments) try {
  assert(level >= 0 && level <= 7);
  const auto platform = nidus::NDPlatform::registered();
  if (!platform) return;
  const auto message = platform->systemLog()->createMessage();
  if (!message) return;
  message->set("Level", nidus::kLevelNames[static_cast<std::size_t>(level)]);
  message->set("Facility", nidus::kFacility);
  if (format) message->set("Message", nidus::formatted(format, arguments));
  if (nidus::isConnected()) nidus::connection->client->send(*message);
} catch (...) {
}
