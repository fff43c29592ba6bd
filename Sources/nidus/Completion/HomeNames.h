#pragma once

#include <optional>
#include <string>
#include <vector>

#include "HomePlatform/Store/HomeData.h"
#include "PlatformModel/Assistant/VAHAEntity.h"
#include "nidus/Candidates.h"

namespace nidus {

/// The name of a thing of a home, or of the data folder, which is in no home.
struct HomeName {
  CandidateKind kind = CandidateKind::homes;  ///< One of homes, rooms, zones, backups and so on.
  std::string name;                           ///< Not empty.
  std::string home;                           ///< The name of the home that it is in.
};

/// The names of homes and of all in them that has one. Names may repeat.
[[nodiscard]] std::vector<HomeName> namesIn(const std::vector<HomeData>& homes);

/// The name that the assistant learns from a sync; none from an entity without a name or of a kind
/// that is not completed.
[[nodiscard]] std::optional<HomeName> nameOf(const VAHAEntity& entity);

}  // namespace nidus
