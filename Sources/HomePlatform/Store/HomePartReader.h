#pragma once

#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "HomePlatform/Json/JsonObject.h"
#include "HomePlatform/Json/JsonPath.h"
#include "HomePlatform/Store/HomeData.h"
#include "HomePlatform/Store/SharedTexts.h"

namespace nidus {

/// Reads one object of a home document. The objects of its lists are read before it ends, each by a
/// reader of its own, so that the document never stands in memory as a tree.
class HomePartReader {
 public:
  /// A list of objects within the object: its key, and a new reader for each of its elements.
  struct List {
    std::string_view key;
    std::function<std::unique_ptr<HomePartReader>()> makeElementReader;
  };

  virtual ~HomePartReader() = default;
  HomePartReader() = default;
  HomePartReader(const HomePartReader&) = delete;
  HomePartReader& operator=(const HomePartReader&) = delete;

  [[nodiscard]] const std::vector<List>& lists() const { return lists_; }
  /// Hears of a value that is neither object nor array as soon as it is there.
  virtual void see(std::string_view /*key*/, const JsonValue& /*value*/, const JsonPath& /*path*/) {
  }
  /// Takes the object when it ends; its `lists` have been read already and stand in it as empty
  /// arrays. Keys that are not asked for are refused afterwards. Throws `JsonError`.
  virtual void finish(JsonObject& object) = 0;

 protected:
  std::vector<List> lists_;
};

/// Makes the reader of a whole home document that puts the homes into `homes`, checks included.
/// Both references must outlive the reader.
[[nodiscard]] std::unique_ptr<HomePartReader> makeDocumentReader(std::vector<HomeData>& homes,
                                                                 SharedTexts& texts);

}  // namespace nidus
