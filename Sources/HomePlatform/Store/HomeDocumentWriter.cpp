#include <cstdint>
#include <ostream>

#include "HomePlatform/Json/JsonWriter.h"
#include "HomePlatform/Store/HomeDocument.h"
#include "HomePlatform/Store/ValueConversion.h"

namespace nidus {
namespace {

/// Writes the parts of a document; what has its default is left out.
class DocumentWriter {
 public:
  DocumentWriter(std::ostream& out, bool indent) : json_(out, indent) {}

  void write(const std::vector<HomeData>& homes) {
    json_.beginObject();
    json_.key("format").text("nidus-home/1");
    json_.beginLines("homes");
    for (const HomeData& home : homes) writeObject(home);
    json_.endLines();
    json_.endObject();
    json_.flush();
  }

 private:
  template <class Data>
  void writeObject(const Data& data) {
    json_.beginObject();
    writeMembers(data);
    json_.endObject();
  }

  template <class Data>
  void writeList(const char* key, const std::vector<Data>& list) {
    if (list.empty()) return;
    json_.beginLines(key);
    for (const Data& data : list) writeObject(data);
    json_.endLines();
  }

  template <class Data>
  void writeIdentity(const Data& data) {
    json_.key("uuid").uuid(data.uuid);
    json_.key("name").text(data.name);
  }

  void writeText(const char* key, const NDString& text) {
    if (text) json_.key(key).text(text);
  }

  void writeValue(const char* key, const NDValueRef& value) {
    if (value) json_.key(key).value(value);
  }

  void writeCode(const char* key, std::int32_t code) {
    if (code != 0) json_.key(key).integer(code);
  }

  void writeFaults(const FaultData& faults) {
    if (faults == FaultData()) return;
    json_.key("faults").beginObject();
    writeCode("read", faults.read);
    writeCode("write", faults.write);
    json_.endObject();
  }

  void writeMembers(const HomeData& home) {
    writeIdentity(home);
    if (home.primary) json_.key("primary").boolean(true);
    writeList("rooms", home.rooms);
    writeList("zones", home.zones);
    writeList("accessories", home.accessories);
    writeList("serviceGroups", home.serviceGroups);
    writeList("actionSets", home.actionSets);
    writeList("triggers", home.triggers);
    writeFaults(home.faults);
  }

  void writeMembers(const RoomData& room) { writeIdentity(room); }
  void writeMembers(const TriggerData& trigger) { writeIdentity(trigger); }

  void writeMembers(const ZoneData& zone) {
    writeIdentity(zone);
    if (zone.rooms.empty()) return;
    json_.key("rooms").beginArray();
    for (const NDUUID& room : zone.rooms) json_.uuid(room);
    json_.endArray();
  }

  void writeMembers(const AccessoryData& accessory) {
    writeIdentity(accessory);
    if (accessory.room) json_.key("room").uuid(*accessory.room);
    if (!accessory.reachable) json_.key("reachable").boolean(false);
    if (accessory.requiresUnlock) json_.key("requiresUnlock").boolean(true);
    writeList("services", accessory.services);
    writeFaults(accessory.faults);
  }

  void writeMembers(const ServiceData& service) {
    json_.key("instanceID").integer(service.instanceID);
    writeText("name", service.name);
    writeText("serviceType", service.serviceType);
    writeText("associatedServiceType", service.associatedServiceType);
    writeList("characteristics", service.characteristics);
  }

  void writeMembers(const CharacteristicData& characteristic) {
    json_.key("instanceID").integer(characteristic.instanceID);
    writeText("characteristicType", characteristic.characteristicType);
    writeProperties(characteristic.properties);
    writeValue("value", characteristic.value);
    if (!isSameValue(characteristic.value, characteristic.deviceValue)) {
      writeValue("deviceValue", characteristic.deviceValue);
    }
    if (characteristic.metadata) {
      json_.key("metadata");
      writeObject(*characteristic.metadata);
    }
    writeFaults(characteristic.faults);
  }

  void writeProperties(const std::vector<NDString>& properties) {
    if (properties.empty()) return;
    json_.key("properties").beginArray();
    for (const NDString& word : properties) json_.text(word);
    json_.endArray();
  }

  void writeMembers(const MetadataData& metadata) {
    writeText("format", metadata.format);
    writeText("units", metadata.units);
    writeValue("minimumValue", metadata.minimumValue);
    writeValue("maximumValue", metadata.maximumValue);
    writeValue("stepValue", metadata.stepValue);
  }

  void writeMembers(const ServiceGroupData& group) {
    writeIdentity(group);
    writeList("services", group.services);
  }

  void writeMembers(const ServiceAddress& address) {
    json_.key("accessory").uuid(address.accessory);
    json_.key("service").integer(address.service);
  }

  void writeMembers(const ActionSetData& actionSet) {
    writeIdentity(actionSet);
    writeList("actions", actionSet.actions);
    if (actionSet.executeFault == 0) return;
    json_.key("faults").beginObject();
    writeCode("execute", actionSet.executeFault);
    json_.endObject();
  }

  void writeMembers(const SceneActionData& action) {
    json_.key("accessory").uuid(action.target.accessory);
    json_.key("service").integer(action.target.service);
    json_.key("characteristic").integer(action.target.characteristic);
    json_.key("value").value(action.value);
  }

  JsonWriter json_;
};

}  // namespace

void writeHomeDocument(std::ostream& out, const std::vector<HomeData>& homes, bool indent) {
  DocumentWriter(out, indent).write(homes);
  if (indent) out << '\n';
}

}  // namespace nidus
