#pragma once

#include <string>
#include <vector>

#include "HomePlatform/Result.h"
#include "HomePlatform/Store/HomeData.h"
#include "nidus/Watch/HomeChange.h"

namespace nidus {

/// Which objects are watched. An empty text is a field that was not given. Homes go by their very
/// name, rooms and services by theirs whatever its accents are, as in orders.
struct WatchFilter {
  std::string home;
  std::string room;
  std::string service;
};

/// Whether a change concerns an object of the filter: one that fits it now or did before.
[[nodiscard]] bool isWatched(const HomeChange& change, const WatchFilter& filter);

/// Refuses a filter with a name that nothing has among `homes`; says what was perhaps meant.
[[nodiscard]] Status checkFilter(const std::vector<HomeData>& homes, const WatchFilter& filter);

/// What there is to watch, such as "57 services of 2 homes"; without homes how one comes about.
[[nodiscard]] std::string extentOf(const std::vector<HomeData>& homes, const WatchFilter& filter);

}  // namespace nidus
