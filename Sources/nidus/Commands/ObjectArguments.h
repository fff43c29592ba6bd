#pragma once

#include "nidus/CommandSyntax.h"
#include "nidus/HomeEditing/HomeObjects.h"

namespace nidus {

/// Declares the argument NAME and the option --home, which together name an object of the kind that
/// `words` have; a home has no option --home. `words` live as long as the command.
void declareObjectArguments(CommandSyntax& syntax, ObjectWords& words);

/// The names of the objects of a kind, as far as they can be completed.
[[nodiscard]] Candidates candidatesOf(ObjectKind kind);

/// "a room", "an accessory".
[[nodiscard]] std::string withArticle(ObjectKind kind);

/// A name as an object of `kind` may have, quoted as on a command line: "Floor lamp/Lamp".
[[nodiscard]] std::string exampleName(ObjectKind kind);

}  // namespace nidus
