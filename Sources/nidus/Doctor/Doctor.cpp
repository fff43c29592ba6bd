#include "nidus/Doctor/Doctor.h"

#include <array>

#include "nidus/Doctor/Checks.h"

namespace nidus {
namespace {

bool always(const Examination& /*examination*/) { return true; }

/// All that fails for want of a folder is the folder's matter.
bool mayHaveFiles(const Examination& examination) { return !examination.folderFailure; }

/// Homes that cannot be read are the database's matter.
bool mayHaveHomes(const Examination& examination) {
  return mayHaveFiles(examination) && (examination.homes || !examination.hasDatabase);
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
    Check{"data folder", always, checkDataFolder},
    Check{"database", mayHaveFiles, checkDatabase},
    Check{"plug-in", always, checkModule},
    Check{"vocabulary", mayHaveFiles, checkVocabulary},
    Check{"preferences", mayHaveFiles, checkPreferences},
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
