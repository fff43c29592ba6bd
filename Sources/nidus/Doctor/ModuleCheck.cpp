#include "nidus/Doctor/Checks.h"
#include "nidus/Doctor/Remedy.h"

namespace nidus {

void checkModule(const Examination& examination, Findings& findings) {
  if (examination.moduleFailure) findings.push_back(findingOf(*examination.moduleFailure));
}

}  // namespace nidus
