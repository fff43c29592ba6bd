#pragma once

#include <cstdint>
#include <iosfwd>
#include <string>
#include <string_view>
#include <vector>

#include "PlatformModel/System/NDString.h"
#include "PlatformModel/System/NDUUID.h"
#include "PlatformModel/System/NDValue.h"

namespace nidus {

/// Writes a JSON document piece by piece to a stream: lists of parts with each part on a line of
/// its own (or, without indentation, everything on one line), all else on the line of its part.
/// Not synchronised; the stream must outlive it and has everything when `flush` returns.
///
///     JsonWriter writer(out, true);
///     writer.beginObject();
///     writer.key("name").text("Beach House");
///     writer.beginLines("rooms");  // … objects …
///     writer.endLines();
///     writer.endObject();
///     writer.flush();
class JsonWriter {
 public:
  JsonWriter(std::ostream& out, bool indent) : out_(out), indent_(indent) {}

  void beginObject();
  void endObject();
  /// The next value written belongs to `key`.
  JsonWriter& key(std::string_view key);
  /// An array whose elements share the line.
  void beginArray() { open('['); }
  void endArray() { close(']'); }
  /// An array under `key` whose elements each have a line.
  void beginLines(std::string_view key);
  void endLines();

  void text(const NDString& text);
  void uuid(const NDUUID& uuid);
  void boolean(bool value);
  void integer(std::int64_t value);
  /// Null is written as `null`.
  void value(const NDValueRef& value);

  /// Hands what has been written to the stream.
  void flush();

 private:
  struct Level {
    bool isEmpty = true;
    bool hasLines = false;  ///< Whether what comes next has a line of its own.
  };

  void beginValue();
  void open(char bracket);
  void close(char bracket);
  void breakLine();

  std::ostream& out_;
  bool indent_;
  bool isAfterKey_ = false;
  std::string buffer_;
  std::vector<Level> levels_;
};

}  // namespace nidus
