#include <cstddef>
#include <utility>

#include "AssistantHost/JsonLine.h"
#include "AssistantHost/Transcript.h"
#include "nidus/Explain/Explanation.h"
#include "nidus/Explain/HomeIndex.h"

namespace nidus {
namespace {

NDDictionaryValue textOf(const NDUUID& uuid) { return NDDictionaryValue(uuid.UUIDString()); }

NDDictionary placeOf(const HomeCharacteristic& place) {
  NDDictionary dictionary = transcriptOf(place.address);
  dictionary.set("home", textOf(place.home));
  return dictionary;
}

NDDictionaryList stepsOf(const Rehearsal& rehearsal) {
  NDDictionaryList list;
  for (const FilterStep& step : rehearsal.steps) {
    NDDictionary entry;
    entry.set("step", NDDictionaryValue(NDString(step.name)));
    entry.set("kept", NDDictionaryValue(step.kept));
    list.emplace_back(std::move(entry));
  }
  return list;
}

NDDictionaryList reachedOf(const Rehearsal& rehearsal, const HomeIndex& before) {
  NDDictionaryList list;
  for (const HomeCharacteristic& place : rehearsal.reached) {
    NDDictionary entry = placeOf(place);
    const auto* found = before.find(place);
    if (found) entry.set("value", transcriptOf(found->characteristic->value));
    list.emplace_back(std::move(entry));
  }
  return list;
}

NDDictionaryList changesOf(const HomeIndex& before, const HomeIndex& after) {
  NDDictionaryList list;
  for (std::size_t i = 0; i < before.all().size() && i < after.all().size(); ++i) {
    const PlacedCharacteristic& old = before.all()[i];
    const PlacedCharacteristic& now = after.all()[i];
    if (now.hasValueOf(old)) continue;
    NDDictionary entry = placeOf(old.place());
    entry.set("before", transcriptOf(old.characteristic->value));
    entry.set("after", transcriptOf(now.characteristic->value));
    list.emplace_back(std::move(entry));
  }
  return list;
}

template <class Part>
NDDictionaryList transcriptsOf(const std::vector<Part>& parts) {
  NDDictionaryList list;
  for (const Part& part : parts) list.emplace_back(transcriptOf(part));
  return list;
}

}  // namespace

std::string explanationJson(const Explanation& explanation, const RehearsalStage& stage) {
  const HomeIndex before(stage.homes());
  std::string lines;
  for (const Rehearsal& rehearsal : explanation.rehearsals) {
    NDDictionaryList replies(rehearsal.replies.begin(), rehearsal.replies.end());
    NDDictionary line;
    line.set("filter", NDDictionaryValue(stepsOf(rehearsal)));
    line.set("reached", NDDictionaryValue(reachedOf(rehearsal, before)));
    line.set("platform", NDDictionaryValue(transcriptsOf(rehearsal.calls)));
    line.set("changes", NDDictionaryValue(changesOf(before, HomeIndex(rehearsal.after))));
    line.set("log", NDDictionaryValue(transcriptsOf(rehearsal.log)));
    line.set("replies", NDDictionaryValue(std::move(replies)));
    lines += jsonLine(line);
  }
  return lines;
}

}  // namespace nidus
