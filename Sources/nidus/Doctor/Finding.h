#pragma once

#include <string>
#include <vector>

namespace nidus {

/// How much a finding matters.
enum class Severity {
  note,       ///< Good to know; nothing is wrong.
  attention,  ///< Something does not work as a person would expect.
};

/// Something that the doctor has found, for people, each part on one line.
struct Finding {
  Severity severity = Severity::attention;
  std::string place;    ///< The file or the object, such as "Cottage / Kitchen / Lamp".
  std::string message;  ///< What is wrong and what it leads to.
  std::string remedy;   ///< The command to type or what else to do.
};

/// In the order in which they were found.
using Findings = std::vector<Finding>;

/// What one check has found; empty findings when all is well there.
struct AreaFindings {
  std::string area;
  Findings findings;
};

}  // namespace nidus
