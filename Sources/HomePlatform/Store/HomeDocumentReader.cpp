#include <string>
#include <utility>

#include "HomePlatform/Json/JsonBuilder.h"
#include "HomePlatform/Json/JsonReader.h"
#include "HomePlatform/Store/HomeDocument.h"
#include "HomePlatform/Store/HomePartReader.h"

namespace nidus {
namespace {

/// Takes the events of a document and gives each object to a part reader of its own. Only what an
/// object holds beside its lists is put together to a value, and dropped when the object ends.
class DocumentEvents final : public JsonEvents {
 public:
  explicit DocumentEvents(std::vector<HomeData>& homes)
      : root_(makeDocumentReader(homes, texts_)) {}

  void scalar(JsonValue value, const JsonPath& path) override {
    refuseUnlessValueFits(std::holds_alternative<std::nullptr_t>(value.content), path);
    Part& part = parts_.back();
    if (part.depth == 0) part.reader->see(part.key, value, path);
    part.rest.scalar(std::move(value), path);
  }

  void key(std::string_view key, const JsonPath& path) override {
    Part& part = parts_.back();
    if (part.depth == 0) {
      part.key = key;
      part.list = listOf(*part.reader, key);
    }
    part.rest.key(key, path);
  }

  void beginObject(const JsonPath& path) override {
    if (parts_.empty()) {
      open(std::move(root_), path);
    } else if (parts_.back().isListOpen) {
      open(parts_.back().list->makeElementReader(), path);
    } else {
      refuseUnlessValueFits(false, path);
      ++parts_.back().depth;
      parts_.back().rest.beginObject(path);
    }
  }

  void endObject(const JsonPath& path) override {
    Part& part = parts_.back();
    part.rest.endObject(path);
    if (part.depth > 0) {
      --part.depth;
      return;
    }
    const JsonValue value = part.rest.take();
    JsonObject object(JsonPlaced(value, path.place()));
    part.reader->finish(object);
    for (const HomePartReader::List& list : part.reader->lists()) object.allow(list.key);
    object.refuseUnknownKeys();
    parts_.pop_back();
  }

  void beginArray(const JsonPath& path) override {
    if (!parts_.empty() && parts_.back().list && !parts_.back().isListOpen) {
      parts_.back().isListOpen = true;
    } else {
      refuseUnlessValueFits(false, path);
      ++parts_.back().depth;
    }
    parts_.back().rest.beginArray(path);
  }

  void endArray(const JsonPath& path) override {
    Part& part = parts_.back();
    part.rest.endArray(path);
    if (part.isListOpen) {
      part.isListOpen = false;
    } else {
      --part.depth;
    }
  }

 private:
  struct Part {
    std::unique_ptr<HomePartReader> reader;
    JsonBuilder rest{kHomeDocumentLimits.valuesInMemory};
    std::string key;                             ///< The key whose value is read.
    const HomePartReader::List* list = nullptr;  ///< The list that `key` names, or null.
    bool isListOpen = false;                     ///< Whether its elements are read.
    int depth = 0;                               ///< How deep we are within `rest`.
  };

  static const HomePartReader::List* listOf(const HomePartReader& reader, std::string_view key) {
    for (const HomePartReader::List& list : reader.lists()) {
      if (list.key == key) return &list;
    }
    return nullptr;
  }

  void open(std::unique_ptr<HomePartReader> reader, const JsonPath& path) {
    parts_.emplace_back();
    parts_.back().reader = std::move(reader);
    parts_.back().rest.beginObject(path);
  }

  /// Refuses anything but an object as the document and as the element of a list, and anything but
  /// an array or null as a list.
  void refuseUnlessValueFits(bool isNull, const JsonPath& path) const {
    if (parts_.empty() || parts_.back().isListOpen) {
      throw JsonError{path.place(), "expected an object"};
    }
    if (parts_.back().list && !isNull) throw JsonError{path.place(), "expected an array"};
  }

  SharedTexts texts_;
  std::unique_ptr<HomePartReader> root_;
  std::vector<Part> parts_;
};

}  // namespace

Result<std::vector<HomeData>> readHomeDocument(std::istream& in, const std::string& name) {
  std::vector<HomeData> homes;
  try {
    DocumentEvents events(homes);
    readJson(in, events, kHomeDocumentLimits);
  } catch (const JsonError& error) {
    return failureOf(error, name);
  }
  return homes;
}

std::unique_ptr<JsonEvents> makeHomeDocumentEvents(std::vector<HomeData>& homes) {
  return std::make_unique<DocumentEvents>(homes);
}

}  // namespace nidus
