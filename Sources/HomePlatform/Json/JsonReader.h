#pragma once

#include <iosfwd>
#include <string>
#include <string_view>

#include "HomePlatform/Json/JsonLimits.h"
#include "HomePlatform/Json/JsonPath.h"
#include "HomePlatform/Json/JsonValue.h"

namespace nidus {

/// Receives a JSON text piece by piece. `path` is where the value stands; a receiver that does not
/// like what it gets throws a `JsonError`, which ends the reading.
class JsonEvents {
 public:
  virtual ~JsonEvents() = default;

  /// A null, boolean, number or text.
  virtual void scalar(JsonValue value, const JsonPath& path) = 0;
  /// What follows up to `endObject` is keys, each followed by its value.
  virtual void beginObject(const JsonPath& path) = 0;
  /// `path` is already that of the key's value.
  virtual void key(std::string_view key, const JsonPath& path) = 0;
  virtual void endObject(const JsonPath& path) = 0;
  /// What follows up to `endArray` is the elements.
  virtual void beginArray(const JsonPath& path) = 0;
  virtual void endArray(const JsonPath& path) = 0;
};

/// Reads one JSON text, with all checks of `parseJson` but that of `valuesInMemory`, and passes it
/// on as events. Nothing is kept but the keys of the objects that are open. Throws `JsonError`.
void readJson(std::string_view text, JsonEvents& events, const JsonLimits& limits = {});
void readJson(std::istream& in, JsonEvents& events, const JsonLimits& limits = {});

}  // namespace nidus
