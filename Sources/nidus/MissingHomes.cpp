#include "nidus/MissingHomes.h"

#include "nidus/Preferences/PreferenceReport.h"

namespace nidus {

std::string missingHomesText(bool hasHomes, HomePlatform& platform) {
  if (!hasHomes) {
    return "There are no homes yet; import some with nidus home import FILE (nidus demo --home "
           "prints some to begin with), or add one with nidus home add home NAME";
  }
  if (areHomesConfigured(platform)) return {};
  return "The plug-in does not look for homes, as kHomesConfigured is not true; change that with "
         "nidus preferences set kHomesConfigured true";
}

}  // namespace nidus
