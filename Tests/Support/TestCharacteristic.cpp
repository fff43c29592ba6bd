#include "Support/TestCharacteristic.h"

#include <utility>

namespace nidus {
namespace {

class TestCharacteristicMetadata final : public NDCharacteristicMetadata {
 public:
  TestCharacteristicMetadata(NDString format, NDString units, NDValueRef minimum,
                             NDValueRef maximum, NDValueRef step)
      : format_(std::move(format)),
        units_(std::move(units)),
        minimum_(std::move(minimum)),
        maximum_(std::move(maximum)),
        step_(std::move(step)) {}

  [[nodiscard]] const NDString& format() const override { return format_; }
  [[nodiscard]] const NDString& units() const override { return units_; }
  [[nodiscard]] const NDValueRef& minimumValue() const override { return minimum_; }
  [[nodiscard]] const NDValueRef& maximumValue() const override { return maximum_; }
  [[nodiscard]] const NDValueRef& stepValue() const override { return step_; }

 private:
  const NDString format_;
  const NDString units_;
  const NDValueRef minimum_;
  const NDValueRef maximum_;
  const NDValueRef step_;
};

}  // namespace

TestCharacteristic::TestCharacteristic(const CharacteristicSpec& spec, std::int64_t instanceID,
                                       std::weak_ptr<NDService> service)
    : instanceID_(spec.instanceID_ != 0 ? spec.instanceID_ : instanceID),
      type_(spec.type_),
      properties_(spec.properties_),
      metadata_(spec.hasMetadata_
                    ? std::make_shared<TestCharacteristicMetadata>(
                          spec.format_, spec.units_, spec.minimum_, spec.maximum_, spec.step_)
                    : nullptr),
      service_(std::move(service)),
      value_(spec.value_),
      deviceValue_(spec.deviceValue_) {}

NDValueRef TestCharacteristic::value() const {
  const NDLock lock(mutex_);
  return value_;
}

void TestCharacteristic::setValue(NDValueRef value) {
  const NDLock lock(mutex_);
  value_ = std::move(value);
}

void TestCharacteristic::setDeviceValue(NDValueRef value) {
  const NDLock lock(mutex_);
  deviceValue_ = std::move(value);
}

void TestCharacteristic::failReads(std::int64_t code) {
  const NDLock lock(mutex_);
  readError_ = NDError{code, "the test says so"};
}

void TestCharacteristic::failWrites(std::int64_t code) {
  const NDLock lock(mutex_);
  writeError_ = NDError{code, "the test says so"};
}

std::optional<NDError> TestCharacteristic::read() {
  const NDLock lock(mutex_);
  if (!readError_) value_ = deviceValue_;
  return readError_;
}

std::optional<NDError> TestCharacteristic::write(NDValueRef value) {
  const NDLock lock(mutex_);
  if (!writeError_) value_ = deviceValue_ = std::move(value);
  return writeError_;
}

}  // namespace nidus
