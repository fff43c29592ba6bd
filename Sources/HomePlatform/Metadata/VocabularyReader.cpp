#include "HomePlatform/Metadata/VocabularyReader.h"

#include <cerrno>
#include <fstream>
#include <system_error>
#include <unordered_map>
#include <unordered_set>
#include <utility>
#include <vector>

#include "HomePlatform/Json/JsonObject.h"
#include "HomePlatform/System/DocumentFile.h"

namespace nidus {

namespace {

NDString optionalText(JsonObject& object, std::string_view key) {
  const auto placed = object.optional(key);
  return placed ? NDString(placed->text()) : NDString();
}

bool optionalFlag(JsonObject& object, std::string_view key) {
  const auto placed = object.optional(key);
  return placed && placed->boolean();
}

void readEntry(JsonObject& object, ServiceEntry& entry) {
  entry.serviceType = object.required("serviceType").text();
}

void readEntry(JsonObject& object, UnitEntry& entry) {
  entry.unit = object.required("unit").text();
}

ValuePair readPair(const JsonPlaced& placed) {
  JsonObject object(placed);
  ValuePair pair{object.required("assistant").boxed(), object.required("platform").boxed()};
  object.refuseUnknownKeys();
  return pair;
}

void readEntry(JsonObject& object, CharacteristicEntry& entry) {
  entry.read = optionalText(object, "read");
  entry.write = optionalText(object, "write");
  entry.valueType = object.required("valueType").text();
  entry.unit = optionalText(object, "unit");
  entry.localized = optionalFlag(object, "localized");
  entry.follows = optionalFlag(object, "follows");
  const auto values = object.optional("values");
  if (!values) return;
  for (const JsonPlaced& pair : values->array()) entry.values.push_back(readPair(pair));
}

/// What of the platform belongs to an entry, each with the key under which the file says it.
using Belongings = std::vector<std::pair<const char*, NDString>>;

Belongings belongingsOf(const ServiceEntry& entry) { return {{"serviceType", entry.serviceType}}; }

Belongings belongingsOf(const UnitEntry& entry) { return {{"unit", entry.unit}}; }

Belongings belongingsOf(const CharacteristicEntry& entry) {
  Belongings belongings;
  if (entry.read) belongings.emplace_back("read", entry.read);
  if (entry.write && !(entry.write == entry.read)) belongings.emplace_back("write", entry.write);
  return belongings;
}

/// Merges one list of a file into that of the vocabulary.
template <class Entry>
class ListMerge {
 public:
  explicit ListMerge(std::vector<Entry>& list) : list_(list), places_(list.size()) {
    for (std::size_t index = 0; index < list.size(); ++index) {
      indexes_.emplace(list[index].assistantName, index);
    }
  }

  void merge(const JsonPlaced& entries) {
    for (const JsonPlaced& placed : entries.array()) mergeEntry(placed);
    refuseContradictions();
  }

 private:
  void mergeEntry(const JsonPlaced& placed) {
    JsonObject object(placed);
    Entry entry;
    const JsonPlaced name = object.required("assistantName");
    entry.assistantName = name.text();
    readEntry(object, entry);
    object.refuseUnknownKeys();
    if (!namesOfFile_.insert(entry.assistantName).second) {
      name.fail("the name \"" + name.text() + "\" stands earlier in this list");
    }
    put(std::move(entry), placed.place());
  }

  void put(Entry entry, const std::string& place) {
    const auto [found, isNew] = indexes_.emplace(entry.assistantName, list_.size());
    if (isNew) {
      list_.push_back(std::move(entry));
      places_.push_back(place);
    } else {
      list_[found->second] = std::move(entry);
      places_[found->second] = place;
    }
  }

  void refuseContradictions() {
    std::unordered_map<NDString, std::size_t> owners;
    for (std::size_t index = 0; index < list_.size(); ++index) {
      for (const auto& [key, text] : belongingsOf(list_[index])) {
        const auto [owner, isFirst] = owners.emplace(text, index);
        if (!isFirst && owner->second != index) refuse(owner->second, index, key, text);
      }
    }
  }

  /// At least one of two entries that contradict each other is of the file.
  [[noreturn]] void refuse(std::size_t earlier, std::size_t later, const char* key,
                           const NDString& text) {
    if (places_[later].empty()) {
      std::swap(earlier, later);
      for (const auto& [ownKey, ownText] : belongingsOf(list_[later])) {
        if (ownText == text) key = ownKey;
      }
    }
    throw JsonError{places_[later] + '/' + key, '"' + text.str() + "\" belongs to the entry \"" +
                                                    list_[earlier].assistantName.str() +
                                                    "\" already"};
  }

  std::vector<Entry>& list_;
  std::vector<std::string> places_;  ///< Of each entry in the file; empty for those of the base.
  std::unordered_map<NDString, std::size_t> indexes_;
  std::unordered_set<NDString> namesOfFile_;
};

template <class Entry>
void mergeList(JsonObject& document, std::string_view key, std::vector<Entry>& list) {
  if (const auto entries = document.optional(key)) ListMerge<Entry>(list).merge(*entries);
}

Vocabulary merge(Vocabulary vocabulary, const JsonValue& value) {
  JsonObject document(JsonPlaced(value, ""));
  const JsonPlaced format = document.required("format");
  if (format.text() != kVocabularyFormat) {
    format.fail(std::string("expected \"") + kVocabularyFormat + '"');
  }
  mergeList(document, "services", vocabulary.services);
  mergeList(document, "characteristics", vocabulary.characteristics);
  mergeList(document, "units", vocabulary.units);
  document.refuseUnknownKeys();
  return vocabulary;
}

Failure readFailure(const std::filesystem::path& path, int error) {
  return {Failure::Kind::platform, path.string() + ": the vocabulary cannot be read: " +
                                       std::generic_category().message(error) +
                                       "; mend its permissions or remove it"};
}

/// The built-in vocabulary extended by what `file` holds.
Result<Vocabulary> extendBuiltIn(std::istream& file, const std::filesystem::path& path) {
  try {
    const JsonValue document = parseJson(file, kVocabularyLimits);
    return merge(builtInVocabulary(), document);
  } catch (const JsonError& error) {
    Failure failure = failureOf(error, path.string());
    failure.message += "; correct the file or remove it";
    return failure;
  }
}

}  // namespace

Result<Vocabulary> mergeVocabulary(Vocabulary base, std::string_view text,
                                   const std::string& name) {
  try {
    return merge(std::move(base), parseJson(text, kVocabularyLimits));
  } catch (const JsonError& error) {
    return failureOf(error, name);
  }
}

Result<Vocabulary> loadVocabulary(const std::optional<std::filesystem::path>& path) {
  if (!path) return builtInVocabulary();
  if (const std::string kind = noDocumentBut(*path); !kind.empty()) {
    return Failure{Failure::Kind::platform, path->string() + ": " + kind +
                                                " is where the vocabulary has to be; move it away"};
  }
  errno = 0;
  std::ifstream file(*path, std::ios::binary);
  if (!file && errno == ENOENT) return builtInVocabulary();
  if (!file) return readFailure(*path, errno);
  return extendBuiltIn(file, *path);
}

}  // namespace nidus
