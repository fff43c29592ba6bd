#include "Support/TestPlatform.h"

#include <atomic>
#include <functional>
#include <utility>

#include "PlatformModel/System/NDDeliveryHold.h"
#include "PlatformModel/System/NDMutex.h"
#include "Support/TestMetadata.h"

namespace nidus {

class TestPlatform::LogClient final : public NDSystemLogClient {
 public:
  void send(const NDSystemLogMessage& message) override {
    const NDLock lock(mutex_);
    messages_.push_back(message.fields().at("Level") + " " + message.fields().at("Message"));
  }
  void setFilterMask(std::uint32_t /*mask*/) override {}

  [[nodiscard]] std::vector<std::string> messages() const {
    const NDLock lock(mutex_);
    return messages_;
  }
  void clear() {
    const NDLock lock(mutex_);
    messages_.clear();
  }

 private:
  mutable NDMutex mutex_;
  std::vector<std::string> messages_ ND_GUARDED_BY(mutex_);
};

class TestPlatform::Log final : public NDSystemLog {
 public:
  explicit Log(std::shared_ptr<NDSystemLogClient> client) : client_(std::move(client)) {}

  [[nodiscard]] std::shared_ptr<NDSystemLogClient> openClient(const NDString& /*identity*/,
                                                              const NDString& /*facility*/,
                                                              std::uint32_t /*options*/) override {
    return client_;
  }
  [[nodiscard]] std::unique_ptr<NDSystemLogMessage> createMessage() override {
    return std::make_unique<NDSystemLogMessage>();
  }

 private:
  const std::shared_ptr<NDSystemLogClient> client_;
};

class TestPlatform::Preferences final : public NDPreferences {
 public:
  [[nodiscard]] BooleanReading booleanForKey_domain_container(
      const NDString& key, const NDString& domain, const NDString& containerPath) override {
    const bool isKnown =
        key == "kHomesConfigured" && domain == "com.corvane.nidusd" && containerPath == "/homes";
    return {areHomesConfigured && isKnown, isKnown};
  }
  void synchronize() override {}
  [[nodiscard]] std::int64_t integerForKey(const NDString& key) override {
    return key == "NidusLogLevel" ? logLevel.load() : 0;
  }

  bool areHomesConfigured = true;
  std::atomic<int> logLevel{0};
};

class TestPlatform::Locale final : public NDLocale {
 public:
  [[nodiscard]] std::optional<bool> usesMetricSystem() override { return isMetric; }
  std::optional<bool> isMetric = true;
};

/// Keeps the one registration that the plug-in makes.
class TestPlatform::Notifications final : public NDNotificationCenter {
 public:
  [[nodiscard]] std::shared_ptr<Token> registerForName_queue_handler(
      const NDString& /*name*/, std::shared_ptr<NDQueue> /*queue*/,
      std::function<void()> handler) override {
    handler_ = std::move(handler);
    return std::make_shared<Token>();
  }
  /// Calls the handler on the calling thread, so that the change is seen at once.
  void post() const {
    if (handler_) handler_();
  }

 private:
  std::function<void()> handler_;
};

/// Reports its homes, through the shared queue, once it may.
class TestPlatform::Manager final : public NDHomeManager,
                                    public std::enable_shared_from_this<Manager> {
 public:
  explicit Manager(NDArray<NDHome> homes) : homes_(std::move(homes)) {}

  [[nodiscard]] NDArray<NDHome> homes() const override { return homes_; }
  void setDelegate(std::weak_ptr<NDHomeManagerDelegate> delegate) override {
    delegate_ = std::move(delegate);
  }

  void reportOn(const std::shared_ptr<NDQueue>& queue) {
    NDDeliveryHold::whenReleased([queue, self = weak_from_this()] {
      queue->async([self] {
        if (const auto manager = self.lock()) manager->report();
      });
    });
  }

 private:
  void report() {
    if (const auto delegate = delegate_.lock()) {
      delegate->homeManagerDidUpdateHomes(shared_from_this());
    }
  }

  const NDArray<NDHome> homes_;
  std::weak_ptr<NDHomeManagerDelegate> delegate_;
};

namespace {

class NoDeviceInformation final : public NDDeviceInformation {
 public:
  [[nodiscard]] NDValueRef answerForQuery(const NDString& /*query*/) override { return nullptr; }
};

}  // namespace

const std::shared_ptr<TestPlatform>& TestPlatform::shared() {
  static const auto platform = std::make_shared<TestPlatform>();
  return platform;
}

TestPlatform::TestPlatform()
    : metadata_(std::make_shared<TestMetadata>()),
      clock_(std::make_shared<NDSystemClock>()),
      mainQueue_(std::make_shared<NDMainQueue>()),
      sharedQueue_(std::make_shared<NDMainQueue>()),
      logClient_(std::make_shared<LogClient>()),
      notifications_(std::make_shared<Notifications>()),
      preferences_(std::make_shared<Preferences>()),
      locale_(std::make_shared<Locale>()) {}

TestPlatform::~TestPlatform() = default;

std::shared_ptr<NDHomeManager> TestPlatform::createHomeManager() {
  auto manager = std::make_shared<Manager>(homes_);
  if (!isSilent_) manager->reportOn(sharedQueue_);
  return manager;
}

std::shared_ptr<NDPreferences> TestPlatform::preferences() { return preferences_; }

std::shared_ptr<NDDeviceInformation> TestPlatform::deviceInformation() {
  return std::make_shared<NoDeviceInformation>();
}

std::shared_ptr<NDLocale> TestPlatform::locale() { return locale_; }

std::shared_ptr<NDSystemLog> TestPlatform::systemLog() { return std::make_shared<Log>(logClient_); }

std::shared_ptr<NDNotificationCenter> TestPlatform::notificationCenter() { return notifications_; }

void TestPlatform::setHomes(std::vector<std::shared_ptr<TestHome>> homes) {
  homes_ = NDArray<NDHome>(std::vector<std::shared_ptr<NDHome>>(homes.begin(), homes.end()));
}

void TestPlatform::configureHomes(bool areConfigured) {
  preferences_->areHomesConfigured = areConfigured;
}

void TestPlatform::setLocale(std::optional<bool> isMetric) { locale_->isMetric = isMetric; }

void TestPlatform::setLogLevel(int level) {
  preferences_->logLevel = level;
  notifications_->post();
}

void TestPlatform::runUntilIdle() {
  while (sharedQueue_->drain() + mainQueue_->drain() > 0) {
  }
}

std::vector<std::string> TestPlatform::log() const { return logClient_->messages(); }

void TestPlatform::clearLog() { logClient_->clear(); }

}  // namespace nidus
