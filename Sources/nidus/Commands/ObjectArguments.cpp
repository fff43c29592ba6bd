#include "nidus/Commands/ObjectArguments.h"

namespace nidus {

void declareObjectArguments(CommandSyntax& syntax, ObjectWords& words) {
  const bool isService = words.kind == ObjectKind::service;
  syntax.requiredArgument(
      "NAME", words.name,
      isService ? "Its name, or ACCESSORY/NAME, or ACCESSORY/INSTANCE-ID" : "Its name or UUID");
  if (words.kind == ObjectKind::home) return;
  syntax.option("--home", "HOME", words.home,
                "The name or UUID of its home, where several homes have the name");
}

std::string withArticle(ObjectKind kind) {
  return (kind == ObjectKind::accessory ? "an " : "a ") + wordOf(kind);
}

}  // namespace nidus
