#include "nidus/Orders/LimitSearch.h"

#include <algorithm>
#include <memory>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "PlatformModel/Assistant/VAHAConstants.h"
#include "nidus/Answers/Answer.h"
#include "nidus/Answers/ReplyForm.h"
#include "nidus/Answers/ValueText.h"

namespace nidus {
namespace {

/// The limit of one object.
struct KnownLimit {
  std::string service;
  std::string home;
  NDValueRef number;  ///< Never null.

  [[nodiscard]] bool hasNumberOf(const KnownLimit& other) const {
    return number->isEqual(*other.number);
  }
  [[nodiscard]] bool isNamedLike(const KnownLimit& other) const {
    return service == other.service && home == other.home;
  }
};

/// The action type that asks for the limit to which another one sets; empty for all others.
std::string_view questionFor(const NDString& actionType) {
  if (actionType == VAHAActionTypeSET_TO_MINIMUMValue) return VAHAActionTypeGET_MINIMUMValue;
  if (actionType == VAHAActionTypeSET_TO_MAXIMUMValue) return VAHAActionTypeGET_MAXIMUMValue;
  return {};
}

/// A command with another action type and value, for the same attribute.
CommandRef changed(const VAHACommand& command, std::shared_ptr<const VAHAFilter> filter,
                   const NDString& actionType, VAHAValueRef value) {
  auto action = std::make_shared<VAHAAction>(*command.actions().front());
  action->setActionType(actionType);
  action->setValue(std::move(value));
  auto made = std::make_shared<VAHACommand>();
  made->setFilter(std::move(filter));
  made->setActions({std::move(action)});
  return made;
}

NDValueRef numberOf(const NDDictionary& value) {
  for (const auto& [kind, number] : value) {
    if (const auto* whole = std::get_if<std::int64_t>(&number.content())) {
      return NDValue::integer(*whole);
    }
    if (const auto* real = std::get_if<float>(&number.content())) return NDValue::floating(*real);
  }
  return nullptr;
}

std::vector<KnownLimit> limitsIn(const Replies& replies) {
  std::vector<KnownLimit> limits;
  for (const NDDictionary& reply : replies) {
    for (const ObjectResult& result : replyForm(reply).results) {
      if (NDValueRef number = numberOf(result.value)) {
        limits.push_back({result.name, result.home, std::move(number)});
      }
    }
  }
  return limits;
}

/// The filter of a command, for the services of one name in one home alone.
std::shared_ptr<const VAHAFilter> narrowed(const VAHACommand& command, const KnownLimit& limit) {
  const auto& all = dynamic_cast<const VAHASearchCriteriaFilter&>(*command.filter());
  auto filter = std::make_shared<VAHASearchCriteriaFilter>(all);
  filter->setServiceName(limit.service);
  if (!limit.home.empty()) filter->setHomeName(limit.home);
  return filter;
}

/// One of each object; false when objects of one name differ.
bool keepOneOfEachName(std::vector<KnownLimit>& limits) {
  std::vector<KnownLimit> kept;
  for (const KnownLimit& limit : limits) {
    const auto same = std::find_if(kept.begin(), kept.end(), [&limit](const KnownLimit& other) {
      return limit.isNamedLike(other);
    });
    if (limit.service.empty() || (same != kept.end() && !limit.hasNumberOf(*same))) return false;
    if (same == kept.end()) kept.push_back(limit);
  }
  limits = std::move(kept);
  return true;
}

bool isOneNumber(const std::vector<KnownLimit>& limits) {
  return std::all_of(limits.begin(), limits.end(), [&limits](const KnownLimit& limit) {
    return limit.hasNumberOf(limits.front());
  });
}

Failure notToldApart(const std::string& attribute) {
  return {Failure::Kind::badInput,
          attribute +
              ": the limits of these objects differ, and not all of them have a name of their "
              "own; name the objects with --service or --room"};
}

}  // namespace

Result<Order> withLimitValues(Order order, const Vocabulary& vocabulary,
                              const OrderValueReader& values, CommandRunner& runner) {
  const CommandRef command = order.commands.front();
  const NDString actionType = command->actions().front()->actionType();
  const CharacteristicEntry* entry = entryOfAttribute(vocabulary, order.attribute);
  const std::string_view question = questionFor(actionType);
  if (question.empty() || !entry) return order;
  const auto replies = runner.perform(*changed(*command, command->filter(), question, nullptr));
  if (!replies) return replies.failure();
  std::vector<KnownLimit> limits = limitsIn(*replies);
  if (limits.empty()) return order;
  const bool isOne = isOneNumber(limits);
  if (isOne) limits.resize(1);
  if (!isOne && !keepOneOfEachName(limits)) return notToldApart(order.attribute);
  order.commands.clear();
  for (const KnownLimit& limit : limits) {
    auto filter = isOne ? command->filter() : narrowed(*command, limit);
    order.commands.push_back(
        changed(*command, std::move(filter), actionType, values.ofLimit(limit.number, *entry)));
  }
  return order;
}

}  // namespace nidus
