#include "nidus/Orders/SearchFilter.h"

#include <array>
#include <string>
#include <utility>
#include <vector>

#include "PlatformModel/Assistant/VAHAConstants.h"
#include "nidus/Orders/WordChoice.h"

namespace nidus {
namespace {

struct NameField {
  std::string OrderFilter::*name;
  void (VAHASearchCriteriaFilter::*set)(NDString);
};

constexpr std::array<NameField, 6> kNameFields = {{
    {&OrderFilter::home, &VAHASearchCriteriaFilter::setHomeName},
    {&OrderFilter::room, &VAHASearchCriteriaFilter::setRoomName},
    {&OrderFilter::zone, &VAHASearchCriteriaFilter::setZoneName},
    {&OrderFilter::group, &VAHASearchCriteriaFilter::setGroupName},
    {&OrderFilter::service, &VAHASearchCriteriaFilter::setServiceName},
    {&OrderFilter::scene, &VAHASearchCriteriaFilter::setSceneName},
}};

Result<std::string> entityTypeOf(const OrderFilter& filter) {
  static const std::vector<std::string_view> kTypes = {
      VAHAEntityTypeHOMEValue,   VAHAEntityTypeROOMValue,    VAHAEntityTypeZONEValue,
      VAHAEntityTypeGROUPValue,  VAHAEntityTypeSERVICEValue, VAHAEntityTypeSCENEValue,
      VAHAEntityTypeTRIGGERValue};
  if (filter.entity.empty()) {
    return std::string(filter.scene.empty() ? VAHAEntityTypeSERVICEValue
                                            : VAHAEntityTypeSCENEValue);
  }
  return chooseWord(filter.entity, kTypes,
                    "there is no such kind of object; --entity takes home, room, zone, group, "
                    "service, scene or trigger");
}

Result<std::string> serviceTypeOf(const std::string& type, const Vocabulary& vocabulary) {
  std::vector<std::string_view> types;
  for (const ServiceEntry& entry : vocabulary.services) types.push_back(entry.assistantName.view());
  return chooseWord(type, types, "there is no such type of service; see nidus vocabulary");
}

}  // namespace

Result<SearchFilterRef> searchFilter(const OrderFilter& filter, const Vocabulary& vocabulary) {
  auto search = std::make_shared<VAHASearchCriteriaFilter>();
  for (const NameField& field : kNameFields) {
    if (const std::string& name = filter.*field.name; !name.empty()) ((*search).*field.set)(name);
  }
  const auto entityType = entityTypeOf(filter);
  if (!entityType) return entityType.failure();
  search->setEntityType(*entityType);
  if (!filter.type.empty()) {
    const auto serviceType = serviceTypeOf(filter.type, vocabulary);
    if (!serviceType) return serviceType.failure();
    search->setServiceType(*serviceType);
  }
  return SearchFilterRef(std::move(search));
}

}  // namespace nidus
