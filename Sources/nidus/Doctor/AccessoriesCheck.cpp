#include "nidus/Doctor/Checks.h"
#include "nidus/Doctor/Remedy.h"
#include "nidus/ObjectPath.h"

namespace nidus {

void checkAccessories(const Examination& examination, Findings& findings) {
  for (const HomeData& home : *examination.homes) {
    for (const AccessoryData& accessory : home.accessories) {
      if (accessory.reachable) continue;
      findings.push_back(
          {Severity::attention, pathOf(home, accessory), "the accessory cannot be reached",
           "see to its power and network, or remove it with nidus home remove accessory " +
               wordsOf(accessory)});
    }
  }
}

}  // namespace nidus
