#include "Floors.h"

#include <utility>
#include <variant>

namespace nidus {
namespace {

std::string textIn(const NDDictionary& record, std::string_view key) {
  const NDDictionaryValue* value = record.find(key);
  return value ? std::get<NDString>(value->content()).str() : std::string();
}

std::string listedIn(const NDDictionary& record, std::string_view key, std::size_t index) {
  const NDDictionaryValue* value = record.find(key);
  if (!value) return {};
  const auto& list = std::get<NDDictionaryList>(value->content());
  return index < list.size() ? std::get<NDString>(list[index].content()).str() : std::string();
}

std::shared_ptr<VAHAEntity> entityByHand(const AnswerTexts& texts) {
  auto entity = std::make_shared<VAHAEntity>();
  std::array<char, 1 + NDUUID::kTextLength> path;
  path[0] = '/';
  NDUUID::random().writeText(&path[1]);
  entity->setIdentifier(NDURL::make("x-corvane-nidus", "local", {path.data(), path.size()}));
  entity->setName(texts.name);
  entity->setEntityType(texts.entityType);
  entity->setServiceType(texts.serviceType);
  entity->setRoom(texts.room);
  entity->setHome(texts.home);
  return entity;
}

class ConstantDevice final : public AnsweringDevice {
 public:
  [[nodiscard]] DeviceResponse read() const override { return {0, value_}; }

 private:
  const NDValueRef value_ = NDValue::integer(40);
};

}  // namespace

FlatRecords flatRecords(const NDDictionaryList& records) {
  FlatRecords flat;
  flat.reserve(records.size());
  for (const NDDictionaryValue& each : records) {
    const auto& record = std::get<NDDictionary>(each.content());
    flat.push_back({textIn(record, "objectName"),
                    textIn(record, "objectIdentifier"),
                    textIn(record, "objectHome"),
                    textIn(record, "objectRoom"),
                    textIn(record, "objectServiceType"),
                    {listedIn(record, "objectCharacteristics", 0),
                     listedIn(record, "objectCharacteristics", 1),
                     listedIn(record, "objectCharacteristics", 2)},
                    listedIn(record, "objectGroups", 0),
                    textIn(record, "objectType"),
                    textIn(record, "objectZone")});
  }
  return flat;
}

FlatRecords copiedTexts(const FlatRecords& records) {
  FlatRecords copies;
  copies.reserve(records.size());
  for (const FlatRecord& record : records) {
    copies.push_back({record.name,
                      record.identifier,
                      record.home,
                      record.room,
                      record.serviceType,
                      record.characteristicTypes,
                      record.group,
                      {},
                      {}});
  }
  return copies;
}

std::vector<const FlatRecord*> equalInEightKeys(const FlatRecords& records,
                                                const FlatRecord& wanted) {
  std::vector<const FlatRecord*> found;
  for (const FlatRecord& record : records) {
    unsigned equal = 0;
    equal += record.home == wanted.home ? 1U : 0U;
    equal += record.entityType == wanted.entityType ? 1U : 0U;
    equal += record.serviceType == wanted.serviceType ? 1U : 0U;
    equal += record.zone == wanted.zone ? 1U : 0U;
    equal += record.room == wanted.room ? 1U : 0U;
    equal += record.group == wanted.group ? 1U : 0U;
    equal += record.name == wanted.name ? 1U : 0U;
    equal += record.characteristicTypes[1] == wanted.characteristicTypes[1] ? 1U : 0U;
    if (equal == 8) found.push_back(&record);
  }
  return found;
}

std::vector<const FlatRecord*> equalInKey(const FlatRecords& records, std::string FlatRecord::*key,
                                          const std::string& wanted) {
  std::vector<const FlatRecord*> found;
  for (const FlatRecord& record : records) {
    if (record.*key == wanted) found.push_back(&record);
  }
  return found;
}

std::vector<AnswerTexts> answerTexts(const FlatRecords& records) {
  std::vector<AnswerTexts> texts;
  texts.reserve(records.size());
  for (const FlatRecord& record : records) {
    texts.push_back(
        {record.name, record.entityType, NDString("LIGHT"), record.room, NDString(record.home)});
  }
  return texts;
}

std::vector<std::shared_ptr<const VAHAEntity>> entitiesByHand(
    const std::vector<AnswerTexts>& texts) {
  std::vector<std::shared_ptr<const VAHAEntity>> entities;
  entities.reserve(texts.size());
  for (const AnswerTexts& each : texts) entities.push_back(entityByHand(each));
  return entities;
}

VAHACommandCompleted::Results resultsByHand(const std::vector<AnswerTexts>& texts) {
  const NDString outcome = "SUCCESS";
  const NDString attribute = "BRIGHTNESS";
  VAHACommandCompleted::Results results;
  results.reserve(texts.size());
  for (const AnswerTexts& each : texts) {
    auto value = std::make_shared<VAHAIntegerValue>();
    value->setValue(40);
    auto result = std::make_shared<VAHAActionResult>();
    result->setOutcome(outcome);
    result->setResultAttribute(attribute);
    result->setResultValue(std::move(value));
    result->setEntity(entityByHand(each));
    results.push_back(std::move(result));
  }
  return results;
}

AnsweringDevices answeringDevices(std::size_t count) {
  AnsweringDevices devices;
  for (std::size_t index = 0; index < count; ++index) {
    devices.push_back(std::make_unique<ConstantDevice>());
  }
  return devices;
}

}  // namespace nidus
