#include "PlatformModel/Assistant/VAHAActionResult.h"

namespace nidus {

NDDictionary VAHAActionResult::dictionary() const {
  NDDictionary form;
  form.reserve(4);
  form.setIfPresent("outcome", outcome_);
  form.setIfPresent("resultAttribute", resultAttribute_);
  if (resultValue_) form.set("resultValue", NDDictionaryValue(resultValue_->dictionary()));
  if (entity_) form.set("entity", NDDictionaryValue(entity_->dictionary()));
  return form;
}

}  // namespace nidus
