#include "nidus/Completion/HomeNames.h"

#include <string_view>
#include <utility>

#include "PlatformModel/Assistant/VAHAConstants.h"

namespace nidus {
namespace {

constexpr std::pair<std::string_view, CandidateKind> kKindOfEntityType[] = {
    {VAHAEntityTypeHOMEValue, CandidateKind::homes},
    {VAHAEntityTypeROOMValue, CandidateKind::rooms},
    {VAHAEntityTypeZONEValue, CandidateKind::zones},
    {VAHAEntityTypeGROUPValue, CandidateKind::groups},
    {VAHAEntityTypeSERVICEValue, CandidateKind::services},
    {VAHAEntityTypeSCENEValue, CandidateKind::scenes},
};

/// Gathers the names of one home.
class NamesOfHome {
 public:
  NamesOfHome(std::vector<HomeName>& names, const HomeData& home)
      : names_(names), home_(home.name.str()) {
    add(CandidateKind::homes, home.name);
    addAll(CandidateKind::rooms, home.rooms);
    addAll(CandidateKind::zones, home.zones);
    addAll(CandidateKind::accessories, home.accessories);
    addAll(CandidateKind::groups, home.serviceGroups);
    addAll(CandidateKind::scenes, home.actionSets);
    addAll(CandidateKind::triggers, home.triggers);
    for (const AccessoryData& accessory : home.accessories) {
      addAll(CandidateKind::services, accessory.services);
    }
  }

 private:
  template <typename Part>
  void addAll(CandidateKind kind, const std::vector<Part>& parts) {
    for (const Part& part : parts) add(kind, part.name);
  }
  void add(CandidateKind kind, const NDString& name) {
    if (!name.view().empty()) names_.push_back({kind, name.str(), home_});
  }

  std::vector<HomeName>& names_;
  const std::string home_;
};

}  // namespace

std::vector<HomeName> namesIn(const std::vector<HomeData>& homes) {
  std::vector<HomeName> names;
  for (const HomeData& home : homes) NamesOfHome(names, home);
  return names;
}

std::optional<HomeName> nameOf(const VAHAEntity& entity) {
  if (entity.name().view().empty()) return std::nullopt;
  for (const auto& [type, kind] : kKindOfEntityType) {
    if (entity.entityType() == type) {
      const bool isHome = kind == CandidateKind::homes;
      return HomeName{kind, entity.name().str(), (isHome ? entity.name() : entity.home()).str()};
    }
  }
  return std::nullopt;
}

}  // namespace nidus
