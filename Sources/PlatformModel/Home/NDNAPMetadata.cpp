#include "PlatformModel/Home/NDNAPMetadata.h"

#include "PlatformModel/NDPlatform.h"

namespace nidus {

NDNAPMetadata::~NDNAPMetadata() = default;

std::shared_ptr<NDNAPMetadata> NDNAPMetadata::getSharedInstance() {
  const auto platform = NDPlatform::registered();
  return platform ? platform->metadata() : nullptr;
}

}  // namespace nidus
