#include "HomePlatform/Metadata/VocabularyWriter.h"

#include <ostream>

#include "HomePlatform/Json/JsonWriter.h"

namespace nidus {
namespace {

/// Writes the entries of a document; what has its default is left out.
class EntryWriter {
 public:
  explicit EntryWriter(std::ostream& out) : json_(out, true) {}

  void write(const Vocabulary& vocabulary) {
    json_.beginObject();
    json_.key("format").text(kVocabularyFormat);
    writeList("services", vocabulary.services);
    writeList("characteristics", vocabulary.characteristics);
    writeList("units", vocabulary.units);
    json_.endObject();
    json_.flush();
  }

 private:
  template <class Entry>
  void writeList(const char* key, const std::vector<Entry>& entries) {
    if (entries.empty()) return;
    json_.beginLines(key);
    for (const Entry& entry : entries) {
      json_.beginObject();
      json_.key("assistantName").text(entry.assistantName);
      writeMembers(entry);
      json_.endObject();
    }
    json_.endLines();
  }

  void writeMembers(const ServiceEntry& entry) { writeText("serviceType", entry.serviceType); }

  void writeMembers(const UnitEntry& entry) { writeText("unit", entry.unit); }

  void writeMembers(const CharacteristicEntry& entry) {
    writeText("read", entry.read);
    writeText("write", entry.write);
    writeText("valueType", entry.valueType);
    writeText("unit", entry.unit);
    if (entry.localized) json_.key("localized").boolean(true);
    if (entry.follows) json_.key("follows").boolean(true);
    if (!entry.values.empty()) writePairs(entry.values);
  }

  void writePairs(const std::vector<ValuePair>& pairs) {
    json_.key("values").beginArray();
    for (const ValuePair& pair : pairs) {
      json_.beginObject();
      json_.key("assistant").value(pair.assistant);
      json_.key("platform").value(pair.platform);
      json_.endObject();
    }
    json_.endArray();
  }

  void writeText(const char* key, const NDString& text) {
    if (text) json_.key(key).text(text);
  }

  JsonWriter json_;
};

}  // namespace

void writeVocabulary(std::ostream& out, const Vocabulary& vocabulary) {
  EntryWriter(out).write(vocabulary);
  out << '\n';
}

}  // namespace nidus
