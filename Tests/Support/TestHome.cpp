#include "Support/TestHome.h"

#include <utility>

#include "PlatformModel/Home/NDLookUp.h"
#include "PlatformModel/NDPlatform.h"

namespace nidus {
namespace {

template <class T>
std::shared_ptr<T> named(const NDArray<T>& list, std::string_view name) {
  for (const auto& element : list) {
    if (element->name() == name) return element;
  }
  return nullptr;
}

NDError errorOf(std::int64_t code) { return NDError{code, "the test says so"}; }

TestCharacteristic& own(NDCharacteristic& characteristic) {
  return static_cast<TestCharacteristic&>(characteristic);
}

}  // namespace

TestHome::TestHome(const NDUUID& uuid, NDString name, bool isPrimary)
    : uuid_(uuid), name_(std::move(name)), isPrimary_(isPrimary) {}

void TestHome::readCharacteristicValues_withCompletionHandler(
    NDArray<NDCharacteristic> characteristics, NDBatchCompletion completion) {
  std::optional<NDError> error;
  {
    const NDLock lock(mutex_);
    reads_.push_back(characteristics);
    error = readError_;
  }
  answer([characteristics, error, completion = std::move(completion)] {
    std::vector<NDCharacteristicResponse> responses;
    if (error) return completion(error, responses);
    for (const auto& each : characteristics) responses.push_back({each, own(*each).read()});
    completion(std::nullopt, responses);
  });
}

void TestHome::writeCharacteristicValues_withCompletionHandler(Writes writes,
                                                               NDBatchCompletion completion) {
  std::optional<NDError> error;
  {
    const NDLock lock(mutex_);
    writes_.push_back(writes);
    error = writeError_;
  }
  answer([writes = std::move(writes), error, completion = std::move(completion)] {
    std::vector<NDCharacteristicResponse> responses;
    if (error) return completion(error, responses);
    for (const auto& [characteristic, value] : writes) {
      responses.push_back({characteristic, own(*characteristic).write(value)});
    }
    completion(std::nullopt, responses);
  });
}

void TestHome::executeActionSet_completionHandler(std::shared_ptr<NDActionSet> actionSet,
                                                  NDExecuteCompletion completion) {
  std::optional<NDError> error;
  {
    const NDLock lock(mutex_);
    executions_.push_back(std::move(actionSet));
    error = executeError_;
  }
  answer([error, completion = std::move(completion)] { completion(error); });
}

std::shared_ptr<TestService> TestHome::service(std::string_view name) const {
  for (const auto& accessory : accessories_) {
    if (auto found = named(accessory->services(), name)) {
      return std::static_pointer_cast<TestService>(found);
    }
  }
  return nullptr;
}

std::shared_ptr<NDAccessory> TestHome::accessory(std::string_view name) const {
  return named(accessories_, name);
}

std::shared_ptr<NDRoom> TestHome::room(std::string_view name) const { return named(rooms_, name); }

std::shared_ptr<NDZone> TestHome::zone(std::string_view name) const { return named(zones_, name); }

std::shared_ptr<NDServiceGroup> TestHome::group(std::string_view name) const {
  return named(groups_, name);
}

std::shared_ptr<NDActionSet> TestHome::scene(std::string_view name) const {
  return named(actionSets_, name);
}

std::shared_ptr<NDTrigger> TestHome::trigger(std::string_view name) const {
  return named(triggers_, name);
}

std::shared_ptr<TestCharacteristic> TestHome::characteristic(std::string_view serviceName,
                                                             std::string_view type) const {
  const auto found = service(serviceName);
  if (!found) return nullptr;
  return std::static_pointer_cast<TestCharacteristic>(
      findInArrayByCharacteristicType(found->characteristics(), type));
}

std::vector<TestHome::Reads> TestHome::reads() const {
  const NDLock lock(mutex_);
  return reads_;
}

std::vector<TestHome::Writes> TestHome::writes() const {
  const NDLock lock(mutex_);
  return writes_;
}

std::vector<std::shared_ptr<NDActionSet>> TestHome::executions() const {
  const NDLock lock(mutex_);
  return executions_;
}

void TestHome::failReads(std::int64_t code) {
  const NDLock lock(mutex_);
  readError_ = errorOf(code);
}

void TestHome::failWrites(std::int64_t code) {
  const NDLock lock(mutex_);
  writeError_ = errorOf(code);
}

void TestHome::failExecutions(std::int64_t code) {
  const NDLock lock(mutex_);
  executeError_ = errorOf(code);
}

void TestHome::answerOn(std::shared_ptr<NDQueue> queue) {
  const NDLock lock(mutex_);
  queue_ = std::move(queue);
}

void TestHome::holdAnswers() {
  const NDLock lock(mutex_);
  isHolding_ = true;
}

std::size_t TestHome::heldAnswers() const {
  const NDLock lock(mutex_);
  return held_.size();
}

void TestHome::releaseAnswers() {
  std::vector<NDTask> tasks;
  {
    const NDLock lock(mutex_);
    tasks.swap(held_);
  }
  for (const NDTask& task : tasks) task();
}

void TestHome::dropAnswers() {
  std::vector<NDTask> dropped;
  const NDLock lock(mutex_);
  dropped.swap(held_);
}

void TestHome::answer(NDTask task) {
  std::shared_ptr<NDQueue> queue;
  {
    const NDLock lock(mutex_);
    if (isHolding_) {
      held_.push_back(std::move(task));
      return;
    }
    queue = queue_;
  }
  if (!queue) queue = NDPlatform::registered()->sharedQueue();
  queue->async(std::move(task));
}

}  // namespace nidus
