#include <algorithm>
#include <array>
#include <cstddef>
#include <utility>

#include "PlatformModel/Assistant/VAHAConstants.h"
#include "PlatformModel/Home/NDCharacteristicConstants.h"
#include "nidus/Orders/Order.h"
#include "nidus/Orders/OrderValue.h"
#include "nidus/Orders/SearchFilter.h"
#include "nidus/Orders/WordChoice.h"

namespace nidus {
namespace {

/// What a relative order without BY goes by, in the device's own unit.
constexpr const char kUsualStep[] = "5";

Failure badInput(std::string message) { return {Failure::Kind::badInput, std::move(message)}; }

std::string joined(const std::vector<std::string>& words, std::size_t first, std::size_t end) {
  std::string text;
  for (std::size_t i = first; i < end; ++i) text += (i == first ? "" : " ") + words[i];
  return text;
}

CommandRef commandOf(SearchFilterRef filter, const Order& order, std::string_view type,
                     VAHAValueRef value = nullptr) {
  auto action = std::make_shared<VAHAAction>();
  action->setActionType(type);
  if (!order.attribute.empty()) action->setAttribute(order.attribute);
  action->setValue(std::move(value));
  auto command = std::make_shared<VAHACommand>();
  command->setFilter(std::move(filter));
  command->setActions({std::move(action)});
  return command;
}

/// Reads one order, verb by verb.
class OrderReader {
 public:
  OrderReader(const OrderWords& words, const Vocabulary& vocabulary, bool isMetric)
      : words_(words),
        vocabulary_(vocabulary),
        isMetric_(isMetric),
        values_(vocabulary, isMetric) {}

  Result<Order> read();

 private:
  using Verb = Status (OrderReader::*)();
  struct VerbEntry {
    std::string_view name;
    Verb read;
  };
  static const std::array<VerbEntry, 7> kVerbs;
  [[nodiscard]] static const VerbEntry* findVerb(std::string_view name);
  [[nodiscard]] Failure unknownVerb() const;

  Status readGet();
  Status readQuestion();
  Status readSet();
  Status readRaise() { return readRelative(Order::Kind::raise, VAHAActionTypeINCREASEValue); }
  Status readLower() { return readRelative(Order::Kind::lower, VAHAActionTypeDECREASEValue); }
  Status readRelative(Order::Kind kind, std::string_view type);
  Status readToggle();
  Status readLimits();
  Status readRun();

  /// Takes the attribute off the words: as many of them as name one.
  Status readAttribute();
  /// What follows the attribute.
  [[nodiscard]] std::string rest() const {
    return joined(words_.words, used_, words_.words.size());
  }
  [[nodiscard]] bool hasMore() const { return used_ < words_.words.size(); }
  [[nodiscard]] Status refuseMore() const;
  /// The value that most likely is asked for by what follows the attribute.
  [[nodiscard]] std::string meantValue() const;
  [[nodiscard]] Failure impossible(const std::string& reason) const;
  void add(std::string_view type, VAHAValueRef value = nullptr) {
    order_.commands.push_back(commandOf(filter_, order_, type, std::move(value)));
  }
  Status addWithValue(std::string_view type, const std::string& text, ValueUse use);

  const OrderWords& words_;
  const Vocabulary& vocabulary_;
  const bool isMetric_;
  const OrderValueReader values_;
  SearchFilterRef filter_;
  const CharacteristicEntry* entry_ = nullptr;
  std::size_t used_ = 0;
  Order order_;
};

constexpr std::array<OrderReader::VerbEntry, 7> OrderReader::kVerbs = {{
    {"get", &OrderReader::readGet},
    {"set", &OrderReader::readSet},
    {"raise", &OrderReader::readRaise},
    {"lower", &OrderReader::readLower},
    {"toggle", &OrderReader::readToggle},
    {"limits", &OrderReader::readLimits},
    {"run", &OrderReader::readRun},
}};

const OrderReader::VerbEntry* OrderReader::findVerb(std::string_view name) {
  const auto* found = std::find_if(kVerbs.begin(), kVerbs.end(),
                                   [name](const VerbEntry& verb) { return verb.name == name; });
  return found == kVerbs.end() ? nullptr : found;
}

Failure OrderReader::unknownVerb() const {
  const std::string& given = words_.verb;
  const std::size_t end = given.find(' ');
  if (end != std::string::npos && findVerb(given.substr(0, end))) {
    return badInput(given + ": write the order without quotes around the whole");
  }
  return badInput(shownWord(given) +
                  ": an order begins with get, set, raise, lower, toggle, limits or run");
}

Result<Order> OrderReader::read() {
  const VerbEntry* verb = findVerb(words_.verb);
  if (!verb) return unknownVerb();
  auto filter = searchFilter(words_.filter, vocabulary_);
  if (!filter) return filter.failure();
  filter_ = std::move(*filter);
  if (words_.asksTarget && verb->read != &OrderReader::readGet) {
    return badInput("--target: only get asks for the value that was set");
  }
  if (auto failure = (this->*verb->read)()) return *failure;
  return std::move(order_);
}

Status OrderReader::readAttribute() {
  const auto& words = words_.words;
  if (words.empty()) {
    return badInput(words_.verb + ": name the attribute; nidus vocabulary lists them");
  }
  std::vector<std::string_view> names;
  for (const auto& entry : vocabulary_.characteristics) {
    names.push_back(entry.assistantName.view());
  }
  for (used_ = words.size(); used_ > 0; --used_) {
    const std::string_view* name = findWord(joined(words, 0, used_), names);
    if (!name) continue;
    entry_ = &vocabulary_.characteristics[static_cast<std::size_t>(name - names.data())];
    order_.attribute = std::string(*name);
    return std::nullopt;
  }
  return unknownWord(words.front(), names, "there is no such attribute; see nidus vocabulary");
}

Status OrderReader::refuseMore() const {
  if (!hasMore()) return std::nullopt;
  return badInput(rest() + ": nothing is expected after " + words_.verb + ' ' + order_.attribute);
}

Failure OrderReader::impossible(const std::string& reason) const {
  return badInput(words_.verb + ' ' + order_.attribute + ": " + reason);
}

Status OrderReader::addWithValue(std::string_view type, const std::string& text, ValueUse use) {
  auto value = values_.read(text, *entry_, use);
  if (!value) return value.failure();
  add(type, std::move(*value));
  return std::nullopt;
}

Status OrderReader::readGet() {
  order_.kind = Order::Kind::get;
  if (!words_.words.empty()) {
    if (auto failure = readAttribute()) return failure;
    if (!entry_->read && !words_.asksTarget) return impossible("it can only be set");
    if (!entry_->write && words_.asksTarget)
      return impossible("it is never set; ask without --target");
  }
  if (hasMore()) return readQuestion();
  add(words_.asksTarget ? VAHAActionTypeGET_TARGET_VALUEValue : VAHAActionTypeGETValue);
  return std::nullopt;
}

std::string OrderReader::meantValue() const {
  const auto& words = words_.words;
  for (std::size_t first = used_; first < words.size(); ++first) {
    std::string text = joined(words, first, words.size());
    if (values_.read(text, *entry_, ValueUse::question)) return text;
  }
  return "VALUE";
}

Status OrderReader::readQuestion() {
  order_.kind = Order::Kind::ask;
  const std::string order = "get " + order_.attribute;
  if (words_.words[used_] != "is") {
    return badInput(rest() + ": to ask which objects have it, write " + order + " is " +
                    meantValue());
  }
  ++used_;
  if (!hasMore()) return badInput(order + " is: name the value");
  if (words_.asksTarget) {
    return badInput("--target: a question compares what is, not what was set; leave one out");
  }
  return addWithValue(VAHAActionTypeGETValue, rest(), ValueUse::question);
}

Status OrderReader::readSet() {
  order_.kind = Order::Kind::set;
  if (auto failure = readAttribute()) return failure;
  const bool isForScenes = order_.attribute == VAHAAttributeENABLEDValue;
  if (!entry_->write && !isForScenes) return impossible("it can only be read; use nidus get");
  if (!hasMore()) return badInput("set " + order_.attribute + ": name the value");
  const std::string word = vocabularyWord(rest());
  if (isNumeric(*entry_) && (word == "MINIMUM" || word == "MIN")) {
    add(VAHAActionTypeSET_TO_MINIMUMValue);
  } else if (isNumeric(*entry_) && (word == "MAXIMUM" || word == "MAX")) {
    add(VAHAActionTypeSET_TO_MAXIMUMValue);
  } else {
    return addWithValue(VAHAActionTypeSETValue, rest(), ValueUse::value);
  }
  return std::nullopt;
}

Status OrderReader::readRelative(Order::Kind kind, std::string_view type) {
  order_.kind = kind;
  if (auto failure = readAttribute()) return failure;
  if (entry_->valueType != NDCharacteristicMetadataFormatInt &&
      entry_->valueType != NDCharacteristicMetadataFormatFloat) {
    return impossible("it is no number that can be raised or lowered; use nidus set");
  }
  if (hasMore()) return addWithValue(type, rest(), ValueUse::difference);
  if (!isOwnUnitUnderstood(*entry_, isMetric_)) {
    return addWithValue(type, kUsualStep, ValueUse::difference);
  }
  add(type);
  return std::nullopt;
}

Status OrderReader::readToggle() {
  order_.kind = Order::Kind::toggle;
  if (auto failure = readAttribute()) return failure;
  if (entry_->valueType != NDCharacteristicMetadataFormatBool) {
    return impossible("it is not on or off; use nidus set");
  }
  add(VAHAActionTypeTOGGLEValue);
  return refuseMore();
}

Status OrderReader::readLimits() {
  order_.kind = Order::Kind::limits;
  if (auto failure = readAttribute()) return failure;
  add(VAHAActionTypeGET_MINIMUMValue);
  add(VAHAActionTypeGET_MAXIMUMValue);
  add(VAHAActionTypeGET_STEP_VALUEValue);
  return refuseMore();
}

Status OrderReader::readRun() {
  order_.kind = Order::Kind::run;
  order_.attribute = std::string(VAHAAttributeENABLEDValue);
  OrderFilter filter = words_.filter;
  if (hasMore() && !filter.scene.empty()) return badInput("run: name the scene once");
  if (hasMore()) filter.scene = rest();
  if (filter.scene.empty()) return badInput("run: name the scene; nidus home show lists them");
  auto scene = searchFilter(filter, vocabulary_);
  if (!scene) return scene.failure();
  filter_ = std::move(*scene);
  auto value = VAHABooleanValue::booleanValue();
  value->setValue(true);
  add(VAHAActionTypeSETValue, std::move(value));
  return std::nullopt;
}

}  // namespace

Result<Order> readOrder(const OrderWords& order, const Vocabulary& vocabulary, bool isMetric) {
  return OrderReader(order, vocabulary, isMetric).read();
}

}  // namespace nidus
