#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <vector>

#include "PlatformModel/Home/NDCharacteristic.h"
#include "PlatformModel/Home/NDError.h"
#include "PlatformModel/System/NDMutex.h"
#include "Support/CharacteristicSpec.h"

namespace nidus {

/// A characteristic of a test home: its cached value, the value that its device has, and the errors
/// with which it answers reads and writes. May be used from any thread.
class TestCharacteristic final : public NDCharacteristic {
 public:
  TestCharacteristic(const CharacteristicSpec& spec, std::int64_t instanceID,
                     std::weak_ptr<NDService> service);

  [[nodiscard]] std::int64_t instanceID() const override { return instanceID_; }
  [[nodiscard]] const NDString& characteristicType() const override { return type_; }
  [[nodiscard]] const std::vector<NDString>& properties() const override { return properties_; }
  [[nodiscard]] const std::shared_ptr<const NDCharacteristicMetadata>& metadata() const override {
    return metadata_;
  }
  [[nodiscard]] NDValueRef value() const override;
  [[nodiscard]] std::shared_ptr<NDService> service() const override { return service_.lock(); }

  void setValue(NDValueRef value);
  void setDeviceValue(NDValueRef value);
  /// Each read, or write, is answered with the error `code` from now on.
  void failReads(std::int64_t code);
  void failWrites(std::int64_t code);

  /// What the home does for a batch: takes the device's value over, or gives the error.
  [[nodiscard]] std::optional<NDError> read();
  [[nodiscard]] std::optional<NDError> write(NDValueRef value);

 private:
  const std::int64_t instanceID_;
  const NDString type_;
  const std::vector<NDString> properties_;
  const std::shared_ptr<const NDCharacteristicMetadata> metadata_;
  const std::weak_ptr<NDService> service_;
  mutable NDMutex mutex_;
  NDValueRef value_ ND_GUARDED_BY(mutex_);
  NDValueRef deviceValue_ ND_GUARDED_BY(mutex_);
  std::optional<NDError> readError_ ND_GUARDED_BY(mutex_);
  std::optional<NDError> writeError_ ND_GUARDED_BY(mutex_);
};

}  // namespace nidus
