#include "Support/TestLog.h"

#include <new>

namespace nidus {

class TestLog::Client final : public NDSystemLogClient {
 public:
  void send(const NDSystemLogMessage& message) override {
    const NDLock lock(mutex_);
    messages_.push_back(message.fields());
  }
  void setFilterMask(std::uint32_t mask) override {
    const NDLock lock(mutex_);
    masks_.push_back(mask);
  }

  [[nodiscard]] std::vector<Fields> messages() const {
    const NDLock lock(mutex_);
    return messages_;
  }
  [[nodiscard]] std::vector<std::uint32_t> masks() const {
    const NDLock lock(mutex_);
    return masks_;
  }
  void clearMessages() {
    const NDLock lock(mutex_);
    messages_.clear();
  }

 private:
  mutable NDMutex mutex_;
  std::vector<Fields> messages_ ND_GUARDED_BY(mutex_);
  std::vector<std::uint32_t> masks_ ND_GUARDED_BY(mutex_);
};

TestLog::TestLog() : client_(std::make_shared<Client>()) {}

TestLog::~TestLog() = default;

std::shared_ptr<NDSystemLogClient> TestLog::openClient(const NDString& identity,
                                                       const NDString& facility,
                                                       std::uint32_t options) {
  if (isExhausted_) throw std::bad_alloc();
  const NDLock lock(mutex_);
  openings_.push_back({identity, facility, options});
  return client_;
}

std::unique_ptr<NDSystemLogMessage> TestLog::createMessage() {
  if (isExhausted_) throw std::bad_alloc();
  return refusesMessages_ ? nullptr : std::make_unique<NDSystemLogMessage>();
}

std::vector<TestLog::Opening> TestLog::openings() const {
  const NDLock lock(mutex_);
  return openings_;
}

std::vector<std::uint32_t> TestLog::filterMasks() const { return client_->masks(); }

std::vector<TestLog::Fields> TestLog::messages() const { return client_->messages(); }

std::vector<std::string> TestLog::lines() const {
  std::vector<std::string> lines;
  for (const Fields& fields : messages()) {
    lines.push_back(fields.at("Level") + " " + fields.at("Message"));
  }
  return lines;
}

void TestLog::clearMessages() { client_->clearMessages(); }

}  // namespace nidus
