#include "nidus/HomeEditing/HomeRenaming.h"

namespace nidus {

Result<std::string> renameObject(std::vector<HomeData>& homes, const ObjectWords& words,
                                 const std::string& newName) {
  if (auto failure = checkName(newName)) return *failure;
  const auto place = findObject(homes, words);
  if (!place) return place.failure();
  const std::string before = describe(homes, words.kind, *place);
  nameAt(homes, words.kind, *place) = NDString(newName);
  return "renamed " + before + " to " + newName;
}

}  // namespace nidus
