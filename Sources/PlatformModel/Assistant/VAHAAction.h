#pragma once

#include <utility>

#include "PlatformModel/Assistant/VAHAValue.h"
#include "PlatformModel/System/NDExport.h"
#include "PlatformModel/System/NDString.h"

namespace nidus {

/// One requested operation. Every property may be null. Not synchronised.
class ND_EXPORT VAHAAction {
 public:
  [[nodiscard]] const NDString& actionType() const noexcept { return actionType_; }
  void setActionType(NDString type) { actionType_ = std::move(type); }
  [[nodiscard]] const NDString& attribute() const noexcept { return attribute_; }
  void setAttribute(NDString attribute) { attribute_ = std::move(attribute); }
  [[nodiscard]] const VAHAValueRef& value() const noexcept { return value_; }
  void setValue(VAHAValueRef value) { value_ = std::move(value); }

 private:
  NDString actionType_;
  NDString attribute_;
  VAHAValueRef value_;
};

/// An action that nobody changes any more, or null.
using VAHAActionRef = std::shared_ptr<const VAHAAction>;

}  // namespace nidus
