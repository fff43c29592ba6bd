#include "PlatformModel/Assistant/VAHACommand.h"

namespace nidus {

VAHACommand::~VAHACommand() = default;

std::shared_ptr<VAHACommandCompleted> VAHACommandCompleted::commandCompleted() {
  return std::make_shared<VAHACommandCompleted>();
}

NDDictionary VAHACommandCompleted::dictionary() const {
  NDDictionaryList results;
  results.reserve(actionResults_.size());
  for (const auto& result : actionResults_) results.emplace_back(result->dictionary());
  NDDictionary form;
  form.setIfPresent("commandOutcome", commandOutcome_);
  form.set("actionResults", NDDictionaryValue(std::move(results)));
  return form;
}

}  // namespace nidus
