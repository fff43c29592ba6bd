#include "nidus/Doctor/Doctor.h"

#include <array>
#include <system_error>

#include "nidus/Doctor/Checks.h"

namespace nidus {
namespace {

bool always(const Examination& /*examination*/) { return true; }

bool hasFolder(const Examination& examination) {
  std::error_code ignored;
  return std::filesystem::exists(examination.folder, ignored);
}

bool hasDatabase(const Examination& examination) { return examination.hasDatabase; }

/// Homes that cannot be read are the database's matter.
bool mayHaveHomes(const Examination& examination) {
  return examination.homes || !examination.hasDatabase;
}

bool hasHomes(const Examination& examination) {
  return examination.homes && !examination.homes->empty();
}

struct Check {
  const char* area;
  bool (*hasSubject)(const Examination&);  ///< Whether there is something to look at.
  void (*run)(const Examination&, Findings&);
};

/// In the order in which people read them: what everything rests on comes first.
constexpr std::array kChecks = {
    Check{"data folder", hasFolder, checkDataFolder},
    Check{"database", hasDatabase, checkDatabase},
    Check{"plug-in", always, checkModule},
    Check{"vocabulary", always, checkVocabulary},
    Check{"preferences", always, checkPreferences},
    Check{"homes", mayHaveHomes, checkHomes},
    Check{"names", hasHomes, checkNames},
    Check{"services", hasHomes, checkAddresses},
    Check{"limits and units", hasHomes, checkMetadata},
    Check{"rooms and zones", hasHomes, checkRooms},
    Check{"groups and scenes", hasHomes, checkTargets},
    Check{"accessories", hasHomes, checkAccessories},
};

}  // namespace

std::vector<AreaFindings> diagnose(const Examination& examination) {
  std::vector<AreaFindings> areas;
  for (const Check& check : kChecks) {
    if (!check.hasSubject(examination)) continue;
    check.run(examination, areas.emplace_back(AreaFindings{check.area, {}}).findings);
  }
  return areas;
}

}  // namespace nidus
