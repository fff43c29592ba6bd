#pragma once

#include <unordered_map>
#include <utility>
#include <vector>

#include "Assistant/TextList.h"
#include "PlatformModel/Home/NDNAPMetadata.h"
#include "PlatformModel/Home/NDService.h"

namespace nidus {

/// Finds out which characteristics of services the assistant can address. Services of one type
/// mostly have the same characteristics, and then share one list. Not synchronised.
class AddressableTypes {
 public:
  /// `metadata` may be null, and then nothing can be addressed. It must outlive this object.
  explicit AddressableTypes(const NDNAPMetadata* metadata) : metadata_(metadata) {}

  /// The types of the service's addressable characteristics, in the order of these, once per time
  /// that one is listed; may be empty.
  [[nodiscard]] TextList of(const NDService& service);

 private:
  /// The characteristics of the last service of one type.
  struct Known {
    std::vector<NDString> all;
    TextList addressable;
  };

  [[nodiscard]] Known& knownOf(const NDString& serviceType);
  [[nodiscard]] Known judged(const NDArray<NDCharacteristic>& characteristics) const;

  const NDNAPMetadata* const metadata_;
  std::unordered_map<NDString, Known> byServiceType_;
  std::pair<const NDString, Known>* last_ = nullptr;  // in the map; its entries stay where they are
};

}  // namespace nidus
