#include "Support/TestPlatform.h"

#include <utility>

#include "Support/TestClock.h"
#include "Support/TestMetadata.h"

namespace nidus {

class TestPlatform::Locale final : public NDLocale {
 public:
  [[nodiscard]] std::optional<bool> usesMetricSystem() override { return isMetric; }
  std::optional<bool> isMetric = true;
};

class TestPlatform::DeviceInformation final : public NDDeviceInformation {
 public:
  [[nodiscard]] NDValueRef answerForQuery(const NDString& query) override {
    ++queries;
    return query == "InternalBuild" ? internalBuild : nullptr;
  }
  NDValueRef internalBuild;
  std::size_t queries = 0;
};

const std::shared_ptr<TestPlatform>& TestPlatform::shared() {
  static const auto platform = std::make_shared<TestPlatform>();
  return platform;
}

TestPlatform::TestPlatform()
    : metadata_(std::make_shared<TestMetadata>()),
      mainQueue_(std::make_shared<NDMainQueue>()),
      sharedQueue_(std::make_shared<NDMainQueue>()),
      clock_(std::make_shared<TestClock>(sharedQueue_)),
      log_(std::make_shared<TestLog>()),
      notifications_(std::make_shared<TestNotifications>()),
      preferences_(std::make_shared<TestPreferences>()),
      deviceInformation_(std::make_shared<DeviceInformation>()),
      locale_(std::make_shared<Locale>()) {}

TestPlatform::~TestPlatform() = default;

std::shared_ptr<NDHomeManager> TestPlatform::createHomeManager() {
  auto manager = std::make_shared<TestHomeManager>(homes_);
  lastManager_ = manager;
  if (isSilent_) return manager;
  if (reporting_ == Reporting::queued) manager->reportOn(sharedQueue_);
  if (reporting_ == Reporting::prompt) manager->reportPromptly();
  if (reporting_ == Reporting::early) manager->reportEarly();
  return manager;
}

std::shared_ptr<NDDeviceInformation> TestPlatform::deviceInformation() {
  return deviceInformation_;
}

std::shared_ptr<NDLocale> TestPlatform::locale() { return locale_; }

void TestPlatform::setHomes(const std::vector<std::shared_ptr<TestHome>>& homes) {
  homes_ = NDArray<NDHome>(std::vector<std::shared_ptr<NDHome>>(homes.begin(), homes.end()));
}

void TestPlatform::configureHomes(std::optional<bool> areConfigured) {
  preferences_->configureHomes(areConfigured);
}

void TestPlatform::setLocale(std::optional<bool> isMetric) { locale_->isMetric = isMetric; }

void TestPlatform::setInternalBuild(NDValueRef answer) {
  deviceInformation_->internalBuild = std::move(answer);
}

std::size_t TestPlatform::deviceQueries() const { return deviceInformation_->queries; }

void TestPlatform::setLogLevel(int level) {
  preferences_->setInteger("NidusLogLevel", level);
  notifications_->post();
}

void TestPlatform::runUntilIdle() {
  while (sharedQueue_->drain() + mainQueue_->drain() > 0) {
  }
}

}  // namespace nidus
