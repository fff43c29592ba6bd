#include "Assistant/HomeObjectRecord.h"

#include "PlatformModel/System/NDOneLine.h"

namespace nidus {
namespace {

NDDictionaryValue listValue(const TextList& texts) {
  NDDictionaryList list;
  list.reserve(texts.size());
  for (const NDString& text : texts) list.emplace_back(text);
  return NDDictionaryValue(std::move(list));
}

void setUnlessEmpty(NDDictionary& dictionary, std::string_view key, const TextList& texts) {
  if (!texts.empty()) dictionary.set(key, listValue(texts));
}

/// Writes the fields of a record as "{key: value, key: [value, value]}".
class FieldWriter {
 public:
  void field(std::string_view key, const NDString& text) {
    if (text) appendOnOneLine(begin(key), text.view());
  }

  void field(std::string_view key, const TextList& texts) {
    if (texts.empty()) return;
    begin(key) += '[';
    for (const NDString& text : texts) {
      if (&text != texts.begin()) out_ += ", ";
      appendOnOneLine(out_, text.view());
    }
    out_ += ']';
  }

  std::string finish() {
    out_ += '}';
    return std::move(out_);
  }

 private:
  std::string& begin(std::string_view key) {
    if (out_ != "{") out_ += ", ";
    return out_.append(key).append(": ");
  }

  std::string out_ = "{";
};

}  // namespace

NDDictionary HomeObjectRecord::dictionary() const {
  NDDictionary dictionary;
  dictionary.setIfPresent(kObjectTypeKey, objectType);
  dictionary.setIfPresent(kObjectNameKey, objectName);
  if (objectIdentifier) {
    dictionary.set(kObjectIdentifierKey, NDDictionaryValue(objectIdentifier.text()));
  }
  dictionary.setIfPresent(kObjectHomeKey, objectHome);
  dictionary.setIfPresent(kObjectRoomKey, objectRoom);
  dictionary.setIfPresent(kObjectZoneKey, objectZone);
  setUnlessEmpty(dictionary, kObjectGroupsKey, objectGroups);
  dictionary.setIfPresent(kObjectServiceTypeKey, objectServiceType);
  dictionary.setIfPresent(kObjectAssociatedServiceTypeKey, objectAssociatedServiceType);
  setUnlessEmpty(dictionary, kObjectCharacteristicsKey, objectCharacteristics);
  return dictionary;
}

std::string description(const HomeObjectRecord& record) {
  FieldWriter writer;
  writer.field(kObjectTypeKey, record.objectType);
  writer.field(kObjectNameKey, record.objectName);
  if (record.objectIdentifier) {
    writer.field(kObjectIdentifierKey, record.objectIdentifier.text());
  }
  writer.field(kObjectHomeKey, record.objectHome);
  writer.field(kObjectRoomKey, record.objectRoom);
  writer.field(kObjectZoneKey, record.objectZone);
  writer.field(kObjectGroupsKey, record.objectGroups);
  writer.field(kObjectServiceTypeKey, record.objectServiceType);
  writer.field(kObjectAssociatedServiceTypeKey, record.objectAssociatedServiceType);
  writer.field(kObjectCharacteristicsKey, record.objectCharacteristics);
  return writer.finish();
}

std::string description(const HomeObjectRecords& records) {
  std::string out = "[";
  for (const HomeObjectRecord& record : records) {
    if (&record != &records.front()) out += ", ";
    out += description(record);
  }
  return out += ']';
}

}  // namespace nidus
