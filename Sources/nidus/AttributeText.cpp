#include "nidus/AttributeText.h"

namespace nidus {

std::string attributeText(const NDString& type, const NDNAPMetadata& metadata) {
  const NDString name = metadata.mapToAssistantCharacteristicName(type);
  if (!name) return type.str();
  const NDString readType = metadata.mapReadCharcteristicFromAssistantName(name);
  return !readType || readType == type ? name.str() : name.str() + " target";
}

}  // namespace nidus
