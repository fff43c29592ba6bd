#include "nidus/Orders/OrderTexts.h"

#include <map>
#include <sstream>

#include "HomePlatform/Metadata/VocabularyReader.h"

namespace nidus {
namespace {

std::string& fieldOf(OrderFilter& filter, const std::string& option) {
  static const std::map<std::string, std::string OrderFilter::*> kFields = {
      {"--home", &OrderFilter::home},       {"--room", &OrderFilter::room},
      {"--zone", &OrderFilter::zone},       {"--group", &OrderFilter::group},
      {"--service", &OrderFilter::service}, {"--scene", &OrderFilter::scene},
      {"--type", &OrderFilter::type},       {"--entity", &OrderFilter::entity}};
  return filter.*kFields.at(option);
}

Result<Order> readLine(const std::string& line, bool isMetric) {
  return readOrder(orderWords(line), builtInVocabulary(), isMetric);
}

/// The class of a value in a word, where its description does not show it.
std::string classOf(const VAHAValue& value) {
  if (dynamic_cast<const VAHAFloatValue*>(&value)) return "float ";
  if (dynamic_cast<const VAHAStringValue*>(&value)) return "text ";
  return dynamic_cast<const VAHABooleanValue*>(&value) ? "boolean " : "";
}

std::string valueText(const VAHAValueRef& value) {
  if (!value) return "";
  const std::string units = value->units() ? ' ' + value->units().str() : "";
  return ' ' + classOf(*value) + value->description() + units;
}

std::string actionsIn(const Result<Order>& order) {
  if (!order) return order.failure().message;
  std::string text;
  for (const CommandRef& command : order->commands) {
    const VAHAAction& action = *command->actions().front();
    text += (text.empty() ? "" : "; ") + action.actionType().str();
    if (action.attribute()) text += ' ' + action.attribute().str();
    text += valueText(action.value());
  }
  return text;
}

}  // namespace

OrderWords orderWords(const std::string& line) {
  OrderWords order;
  std::istringstream words(line);
  words >> order.verb;
  for (std::string word; words >> word;) {
    if (word == "--target") {
      order.asksTarget = true;
    } else if (word.rfind("--", 0) == 0) {
      words >> fieldOf(order.filter, word);
    } else {
      order.words.push_back(word);
    }
  }
  return order;
}

std::string actionsOf(const std::string& line, bool isMetric) {
  return actionsIn(readLine(line, isMetric));
}

std::string actionsOf(const std::string& line, const Vocabulary& vocabulary) {
  return actionsIn(readOrder(orderWords(line), vocabulary, true));
}

std::string filterOf(const std::string& line) {
  const auto order = readLine(line, true);
  if (!order) return order.failure().message;
  const auto& filter =
      dynamic_cast<const VAHASearchCriteriaFilter&>(*order->commands.front()->filter());
  std::string text;
  const auto add = [&text](const char* name, const NDString& value) {
    if (value) text.append(text.empty() ? "" : " ").append(name).append("=").append(value.view());
  };
  add("home", filter.homeName());
  add("room", filter.roomName());
  add("zone", filter.zoneName());
  add("group", filter.groupName());
  add("service", filter.serviceName());
  add("scene", filter.sceneName());
  add("type", filter.serviceType());
  add("entity", filter.entityType());
  add("attribute", filter.attribute());
  return text;
}

}  // namespace nidus
