#include "nidus/Answers/LimitsTable.h"

#include <algorithm>
#include <cstddef>

#include "nidus/Answers/ValueText.h"

namespace nidus {
namespace {

constexpr const char kNoLimit[] = "none";

bool isSameObject(const ObjectResult& a, const ObjectResult& b) {
  return a.name == b.name && a.room == b.room && a.home == b.home && a.type == b.type;
}

/// The first entry of this object that has no limit of this kind yet; a new one when there is none.
ObjectLimits& entryFor(const ObjectResult& object, std::size_t limit,
                       std::vector<ObjectLimits>& objects) {
  const auto entry =
      std::find_if(objects.begin(), objects.end(), [&object, limit](const ObjectLimits& o) {
        return isSameObject(o.object, object) && o.limits.at(limit) == kNoLimit;
      });
  if (entry != objects.end()) return *entry;
  objects.push_back({object, {kNoLimit, kNoLimit, kNoLimit}});
  return objects.back();
}

}  // namespace

bool ObjectLimits::hasAny() const {
  return std::any_of(limits.begin(), limits.end(),
                     [](const std::string& limit) { return limit != kNoLimit; });
}

std::vector<ObjectLimits> limitsByObject(const std::vector<ReplyForm>& replies,
                                         const std::string& attribute,
                                         const Vocabulary& vocabulary) {
  std::vector<ObjectLimits> objects;
  for (std::size_t limit = 0; limit < replies.size(); ++limit) {
    for (const ObjectResult& result : replies[limit].results) {
      std::string& text = entryFor(result, limit, objects).limits.at(limit);
      if (!result.value.empty()) text = limitText(result.value, attribute, vocabulary);
    }
  }
  return objects;
}

TextTable limitsTable(const std::vector<ObjectLimits>& objects) {
  TextTable table({"OBJECT", "ROOM", "HOME", "MINIMUM", "MAXIMUM", "STEP"});
  for (const ObjectLimits& entry : objects) {
    table.addRow({entry.object.nameText(), entry.object.room, entry.object.home, entry.limits[0],
                  entry.limits[1], entry.limits[2]});
  }
  return table;
}

}  // namespace nidus
