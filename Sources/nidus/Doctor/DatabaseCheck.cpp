#include "nidus/Doctor/Checks.h"
#include "nidus/Doctor/Remedy.h"

namespace nidus {

void checkDatabase(const Examination& examination, Findings& findings) {
  for (const Failure& failure : examination.databaseFailures) {
    findings.push_back(findingOf(failure));
  }
}

}  // namespace nidus
