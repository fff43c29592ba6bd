#include "AssistantHost/Transcript.h"

#include <cstddef>
#include <utility>

namespace nidus {
namespace {

NDDictionaryValue textOf(const NDUUID& uuid) { return NDDictionaryValue(uuid.UUIDString()); }

NDDictionaryList readsOf(const PlatformCall& call) {
  NDDictionaryList reads;
  for (const CharacteristicAddress& address : call.characteristics) {
    reads.emplace_back(transcriptOf(address));
  }
  return reads;
}

NDDictionaryList writesOf(const PlatformCall& call) {
  NDDictionaryList writes;
  for (std::size_t i = 0; i < call.characteristics.size(); ++i) {
    NDDictionary write = transcriptOf(call.characteristics[i]);
    write.set("value", transcriptOf(call.values[i]));
    writes.emplace_back(std::move(write));
  }
  return writes;
}

NDDictionary callNamed(const char* name, const PlatformCall& call) {
  NDDictionary dictionary;
  dictionary.set("call", NDDictionaryValue(NDString(name)));
  dictionary.set("home", textOf(call.home));
  return dictionary;
}

}  // namespace

NDDictionaryValue transcriptOf(const NDValueRef& value) {
  if (!value) return {};
  if (value->isBoolean()) return NDDictionaryValue(value->boolValue());
  if (value->isInteger()) return NDDictionaryValue(value->integerValue());
  if (value->isFloating()) return NDDictionaryValue(value->floatValue());
  return NDDictionaryValue(value->stringValue());
}

NDDictionary transcriptOf(const CharacteristicAddress& address) {
  NDDictionary dictionary;
  dictionary.set("accessory", textOf(address.accessory));
  dictionary.set("service", NDDictionaryValue(address.service));
  dictionary.set("characteristic", NDDictionaryValue(address.characteristic));
  return dictionary;
}

NDDictionary transcriptOf(const PlatformCall& call) {
  if (call.kind == PlatformCall::Kind::read) {
    NDDictionary read = callNamed("read", call);
    read.set("characteristics", NDDictionaryValue(readsOf(call)));
    return read;
  }
  if (call.kind == PlatformCall::Kind::write) {
    NDDictionary write = callNamed("write", call);
    write.set("writes", NDDictionaryValue(writesOf(call)));
    return write;
  }
  NDDictionary execution = callNamed("execute", call);
  if (call.actionSet) execution.set("actionSet", textOf(*call.actionSet));
  return execution;
}

NDDictionary transcriptOf(const NDSystemLogMessage& message) {
  NDDictionary dictionary;
  for (const char* key : {"Level", "Facility", "Message"}) {
    const auto field = message.fields().find(key);
    if (field != message.fields().end()) {
      dictionary.set(key, NDDictionaryValue(NDString(field->second)));
    }
  }
  return dictionary;
}

NDDictionary transcriptOf(const SyncChange& change) {
  NDDictionary dictionary;
  dictionary.set("after", NDDictionaryValue(change.after));
  dictionary.set("object", entityValue(change.object));
  dictionary.set("postAnchor", NDDictionaryValue(change.postAnchor));
  return dictionary;
}

}  // namespace nidus
