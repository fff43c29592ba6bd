#pragma once

#include <memory>
#include <utility>

#include "HomePlatform/Store/HomeData.h"
#include "PlatformModel/Home/NDCharacteristicMetadata.h"

namespace nidus {

/// What a characteristic of a loaded home says of its own values.
class MetadataObject final : public NDCharacteristicMetadata {
 public:
  explicit MetadataObject(std::shared_ptr<const MetadataData> data) : data_(std::move(data)) {}

  [[nodiscard]] const NDString& format() const override { return data_->format; }
  [[nodiscard]] const NDString& units() const override { return data_->units; }
  [[nodiscard]] const NDValueRef& minimumValue() const override { return data_->minimumValue; }
  [[nodiscard]] const NDValueRef& maximumValue() const override { return data_->maximumValue; }
  [[nodiscard]] const NDValueRef& stepValue() const override { return data_->stepValue; }

 private:
  const std::shared_ptr<const MetadataData> data_;
};

}  // namespace nidus
