#pragma once

#include <iosfwd>
#include <memory>
#include <string>
#include <vector>

#include "HomePlatform/Json/JsonReader.h"
#include "HomePlatform/Result.h"
#include "HomePlatform/Store/HomeData.h"

namespace nidus {

/// Reads a home document (`nidus-home/1`) as a stream of events; of the document itself no more
/// than one part is in memory at a time. Values and limits come converted to their formats, texts
/// that repeat share their characters. A failure is `badInput` and names the document by `name`,
/// the place as a JSON pointer, and what was expected; it is the first that the reader meets.
[[nodiscard]] Result<std::vector<HomeData>> readHomeDocument(std::istream& in,
                                                             const std::string& name);

/// Makes a reader of a home document that is part of another document, with the same checks: it
/// takes the events of that part and puts the homes into `homes`, which must outlive it. Throws
/// `JsonError`, whose place is that in the outer document.
[[nodiscard]] std::unique_ptr<JsonEvents> makeHomeDocumentEvents(std::vector<HomeData>& homes);

/// Writes a home document; keys that have their default are left out. With `indent` each part has a
/// line of its own and the last one ends, otherwise all is on one line without a line end. Errors
/// show in the state of `out`.
void writeHomeDocument(std::ostream& out, const std::vector<HomeData>& homes, bool indent);

}  // namespace nidus
