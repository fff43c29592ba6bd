#include "HomePlatform/Metadata/MetadataMapper.h"

#include <utility>

namespace nidus {
namespace {

template <class Table>
typename Table::mapped_type lookUp(const Table& table, const NDString& key) {
  const auto found = key ? table.find(key) : table.end();
  return found == table.end() ? typename Table::mapped_type() : found->second;
}

/// Gives the other side of the first pair whose `from` equals `value`, else the value itself.
NDValueRef mapValue(const CharacteristicEntry* entry, const NDValueRef& value,
                    NDValueRef ValuePair::*from, NDValueRef ValuePair::*to) {
  if (!value || !entry) return value;
  for (const ValuePair& pair : entry->values) {
    if ((pair.*from)->isEqual(*value)) return pair.*to;
  }
  return value;
}

}  // namespace

MetadataMapper::MetadataMapper(Vocabulary vocabulary) : vocabulary_(std::move(vocabulary)) {
  for (const ServiceEntry& entry : vocabulary_.services) {
    serviceTypesByName_.emplace(entry.assistantName, entry.serviceType);
    serviceNamesByType_.emplace(entry.serviceType, entry.assistantName);
  }
  for (const UnitEntry& entry : vocabulary_.units) {
    unitsByName_.emplace(entry.assistantName, entry.unit);
    unitNamesByUnit_.emplace(entry.unit, entry.assistantName);
  }
  for (const CharacteristicEntry& entry : vocabulary_.characteristics) {
    entriesByName_.emplace(entry.assistantName, &entry);
    if (entry.read) entriesByType_.emplace(entry.read, &entry);
    if (entry.write) entriesByType_.emplace(entry.write, &entry);
  }
}

NDString MetadataMapper::mapFromAssistantServiceName(const NDString& name) const {
  return lookUp(serviceTypesByName_, name);
}

NDString MetadataMapper::mapToAssistantServiceName(const NDString& type) const {
  return lookUp(serviceNamesByType_, type);
}

NDString MetadataMapper::mapToAssistantCharacteristicName(const NDString& type) const {
  const CharacteristicEntry* entry = entryOfType(type);
  return entry ? entry->assistantName : NDString();
}

NDString MetadataMapper::mapReadCharcteristicFromAssistantName(const NDString& name) const {
  const CharacteristicEntry* entry = entryOf(name);
  return entry ? entry->read : NDString();
}

NDString MetadataMapper::mapWriteCharcteristicFromAssistantName(const NDString& name) const {
  const CharacteristicEntry* entry = entryOf(name);
  return entry ? entry->write : NDString();
}

NDString MetadataMapper::mapCharacteristicValueType(const NDString& name) const {
  const CharacteristicEntry* entry = entryOf(name);
  return entry ? entry->valueType : NDString();
}

NDString MetadataMapper::mapFromAssistantUnitName(const NDString& name) const {
  return lookUp(unitsByName_, name);
}

NDString MetadataMapper::mapToAssistantUnitName(const NDString& unit) const {
  return lookUp(unitNamesByUnit_, unit);
}

NDString MetadataMapper::characteristicValueUnit(const NDString& type) const {
  const CharacteristicEntry* entry = entryOfType(type);
  return entry ? entry->unit : NDString();
}

bool MetadataMapper::supportsLocalization(const NDString& type) const {
  const CharacteristicEntry* entry = entryOfType(type);
  return entry && entry->localized;
}

NDValueRef MetadataMapper::mapFromAssistantCharacteristicValue_name(const NDValueRef& value,
                                                                    const NDString& name) const {
  return mapValue(entryOf(name), value, &ValuePair::assistant, &ValuePair::platform);
}

NDValueRef MetadataMapper::mapToAssistantCharacteristicValue_name(const NDValueRef& value,
                                                                  const NDString& name) const {
  return mapValue(entryOf(name), value, &ValuePair::platform, &ValuePair::assistant);
}

NDString MetadataMapper::followingType(const NDString& writtenType) const {
  const CharacteristicEntry* entry = entryOfType(writtenType);
  const bool isFollowed = entry && entry->follows && entry->write == writtenType;
  return isFollowed && !(entry->read == writtenType) ? entry->read : NDString();
}

const CharacteristicEntry* MetadataMapper::entryOf(const NDString& nameOrType) const {
  const CharacteristicEntry* entry = lookUp(entriesByName_, nameOrType);
  return entry ? entry : lookUp(entriesByType_, nameOrType);
}

const CharacteristicEntry* MetadataMapper::entryOfType(const NDString& type) const {
  return lookUp(entriesByType_, type);
}

}  // namespace nidus
