#pragma once

#include <iosfwd>
#include <string>
#include <vector>

#include "HomePlatform/Json/JsonObject.h"
#include "HomePlatform/Result.h"
#include "HomePlatform/Store/HomeData.h"

namespace nidus {

/// Reads a home document (`nidus-home/1`) as a stream of events; nothing is kept of it but the
/// data. `name` stands for the document in messages. Values and limits come converted to their
/// formats.
[[nodiscard]] Result<std::vector<HomeData>> readHomeDocument(std::istream& in,
                                                             const std::string& name);

/// Reads a home document that is part of another document. Throws `JsonError`.
[[nodiscard]] std::vector<HomeData> homesFromJson(const JsonPlaced& document);

/// Writes a home document; keys that have their default are left out. With `indent` it is written
/// for people, otherwise on one line without a line end.
void writeHomeDocument(std::ostream& out, const std::vector<HomeData>& homes, bool indent);

}  // namespace nidus
