#include "nidus/Orders/OrderRun.h"

#include <algorithm>
#include <utility>

#include "nidus/Orders/LimitSearch.h"
#include "nidus/Outcome.h"

namespace nidus {

Result<Order> readOrderFor(Session& session, const OrderWords& words) {
  HomePlatform& platform = session.platform();
  const bool isMetric = platform.locale()->usesMetricSystem().value_or(false);
  const Vocabulary& vocabulary = platform.vocabulary();
  auto order = readOrder(words, vocabulary, isMetric);
  if (!order) return order;
  if (auto failure = session.openModule()) return *failure;
  const OrderValueReader values(vocabulary, isMetric);
  return withLimitValues(std::move(*order), vocabulary, values, session.runner());
}

Result<std::vector<Replies>> performOrder(Session& session, const Order& order) {
  std::vector<Replies> all;
  for (const CommandRef& command : order.commands) {
    auto replies = session.runner().perform(*command);
    if (!replies) return replies.failure();
    all.push_back(std::move(*replies));
  }
  return all;
}

ExitStatus statusOf(const Order& order, const std::vector<Replies>& replies) {
  std::vector<ExitStatus> statuses;
  statuses.reserve(replies.size());
  for (const Replies& ofCommand : replies) statuses.push_back(statusOf(ofCommand));
  const auto [least, greatest] = std::minmax_element(statuses.begin(), statuses.end());
  return order.kind == Order::Kind::limits ? *least : *greatest;
}

}  // namespace nidus
