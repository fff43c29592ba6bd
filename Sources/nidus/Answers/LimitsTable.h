#pragma once

#include <array>
#include <string>
#include <vector>

#include "HomePlatform/Metadata/Vocabulary.h"
#include "nidus/Answers/ReplyForm.h"
#include "nidus/Terminal/TextTable.h"

namespace nidus {

/// One object with its limits; a limit that it does not have is "none".
struct ObjectLimits {
  ObjectResult object;
  std::array<std::string, 3> limits;  ///< Minimum, maximum and step.

  [[nodiscard]] bool hasAny() const;
};

/// Brings the replies for the minimum, the maximum and the step together, an entry for each object
/// in the order in which they come first. Objects of one name, room and home are told apart by
/// their order.
[[nodiscard]] std::vector<ObjectLimits> limitsByObject(const std::vector<ReplyForm>& replies,
                                                       const std::string& attribute,
                                                       const Vocabulary& vocabulary);

/// A row for each object.
[[nodiscard]] TextTable limitsTable(const std::vector<ObjectLimits>& objects);

}  // namespace nidus
