#include <algorithm>
#include <string>

#include "nidus/Doctor/Checks.h"
#include "nidus/ObjectPath.h"

namespace nidus {
namespace {

constexpr const char* kAddWords =
    "add what it is to vocabulary.json in the data folder; nidus vocabulary shows the words";

/// What the words in use know of a service's characteristics.
enum class Knowledge { none, identifyAlone, some };

Knowledge knowledgeOf(const ServiceData& service, const NDNAPMetadata& metadata) {
  Knowledge knowledge = Knowledge::none;
  for (const CharacteristicData& characteristic : service.characteristics) {
    const NDString name =
        metadata.mapToAssistantCharacteristicName(characteristic.characteristicType);
    if (name && name != "IDENTIFY") return Knowledge::some;
    if (name) knowledge = Knowledge::identifyAlone;
  }
  return knowledge;
}

void addUnknown(const std::string& place, const ServiceData& service, Findings& findings) {
  if (service.characteristics.empty()) {
    findings.push_back({Severity::attention, place,
                        "the assistant cannot address it: it has no characteristics",
                        "give it some with nidus home edit"});
    return;
  }
  findings.push_back({Severity::attention, place,
                      "the assistant cannot address it: no characteristic of it, such as " +
                          service.characteristics.front().characteristicType.str() +
                          ", is in the vocabulary",
                      kAddWords});
}

bool hasKnownType(const ServiceData& service, const NDNAPMetadata& metadata) {
  return metadata.mapToAssistantServiceName(service.serviceType) ||
         metadata.mapToAssistantServiceName(service.associatedServiceType);
}

/// A service that orders can reach, but not in every way.
void checkReached(const std::string& place, const AccessoryData& accessory,
                  const ServiceData& service, const NDNAPMetadata& metadata, Findings& findings) {
  if (!service.name) {
    findings.push_back({Severity::attention, place,
                        "it has no name: orders reach it by its room, group or type alone",
                        "nidus home rename service " + accessory.uuid.UUIDString().str() + '/' +
                            std::to_string(service.instanceID) + " NEWNAME"});
  }
  if (!hasKnownType(service, metadata)) {
    findings.push_back({Severity::attention, place,
                        "its type " + service.serviceType.str() +
                            " is not in the vocabulary: orders cannot reach it by a type",
                        kAddWords});
  }
}

}  // namespace

void checkAddresses(const Examination& examination, Findings& findings) {
  const NDNAPMetadata& metadata = *examination.metadata;
  forEachService(*examination.homes, [&](const HomeData& home, const AccessoryData& accessory,
                                         const ServiceData& service) {
    const std::string place = pathOf(home, accessory, service);
    switch (knowledgeOf(service, metadata)) {
      case Knowledge::none:
        return addUnknown(place, service, findings);
      case Knowledge::identifyAlone:
        findings.push_back({Severity::note, place,
                            "the assistant cannot address it: it can only identify itself",
                            "nothing to do for a bridge or a hub"});
        return;
      case Knowledge::some:
        return checkReached(place, accessory, service, metadata, findings);
    }
  });
}

}  // namespace nidus
