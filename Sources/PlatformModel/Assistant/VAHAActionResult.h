#pragma once

#include <memory>
#include <utility>

#include "PlatformModel/Assistant/VAHAEntity.h"
#include "PlatformModel/Assistant/VAHAValue.h"
#include "PlatformModel/System/NDDictionary.h"
#include "PlatformModel/System/NDExport.h"
#include "PlatformModel/System/NDString.h"

namespace nidus {

/// What became of one object of a command. A field that is not set is null. Not synchronised.
class ND_EXPORT VAHAActionResult {
 public:
  [[nodiscard]] const NDString& outcome() const noexcept { return outcome_; }
  void setOutcome(NDString outcome) { outcome_ = std::move(outcome); }
  [[nodiscard]] const NDString& resultAttribute() const noexcept { return resultAttribute_; }
  void setResultAttribute(NDString attribute) { resultAttribute_ = std::move(attribute); }
  [[nodiscard]] const VAHAValueRef& resultValue() const noexcept { return resultValue_; }
  void setResultValue(VAHAValueRef value) { resultValue_ = std::move(value); }
  [[nodiscard]] const std::shared_ptr<const VAHAEntity>& entity() const noexcept { return entity_; }
  void setEntity(std::shared_ptr<const VAHAEntity> entity) { entity_ = std::move(entity); }

  /// The plain form; fields that are null are left out.
  [[nodiscard]] NDDictionary dictionary() const;

 private:
  NDString outcome_;
  NDString resultAttribute_;
  VAHAValueRef resultValue_;
  std::shared_ptr<const VAHAEntity> entity_;
};

}  // namespace nidus
