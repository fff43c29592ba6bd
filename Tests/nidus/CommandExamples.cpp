#include "nidus/CommandExamples.h"

namespace nidus {
namespace {

CommandChapter filterFields() {
  return {
      "Which objects: the filter",
      "All fields that are given have to fit. Names are compared without regard to accents; upper "
      "and lower case differ. Without any field the order is for every object that has the "
      "attribute, in the primary home when there are several homes.",
      {{"`--home`: all that belongs to one home.", {"get", "brightness", "--home", "Lake Cabin"}},
       {"`--room`: what stands in a room, here spelled without its accent.",
        {"get", "brightness", "--room", "Cafe Corner"}},
       {"`--zone`: what stands in the rooms of a zone.",
        {"get", "brightness", "--zone", "Upstairs"}},
       {"`--group`: the services of a group.", {"get", "brightness", "--group", "Reading Lights"}},
       {"`--service`: the services of a name.", {"get", "volume", "--service", "Soundbar"}},
       {"`--scene`: a scene; `nidus run` takes its name without an option.",
        {"set", "enabled", "on", "--scene", "Movie Night"}},
       {"`--type`: the services of a type. A lamp in an outlet is a light too.",
        {"get", "power", "--type", "light", "--room", "Living Room"}},
       {"`--entity`: objects of one kind: home, room, zone, group, service, scene or trigger.",
        {"get", "--entity", "zone", "--home", "Lake Cabin"}}}};
}

CommandChapter actionTypes() {
  return {"What to do: the actions",
          "Each order becomes a command with one action; `limits` becomes three commands.",
          {{"`GET`: the value as the device has it now.",
            {"get", "temperature", "--service", "Thermostat"}},
           {"`GET` with a value: which objects have it? What cannot be asked stays in the answer.",
            {"get", "power", "is", "on", "--type", "light"}},
           {"`GET_TARGET_VALUE`: the value that was set.",
            {"get", "temperature", "--target", "--service", "Thermostat"}},
           {"`GET_MINIMUM`, `GET_MAXIMUM` and `GET_STEP_VALUE`: the limits.",
            {"limits", "temperature", "--service", "Thermostat"}},
           {"`SET`: a value.", {"set", "brightness", "40%", "--service", "Desk Lamp"}},
           {"`SET` with a unit: it arrives as it was meant, whatever the device shows.",
            {"set", "temperature", "70F", "--service", "Thermostat"}},
           {"`SET` with a word of the attribute.",
            {"set", "climate_mode", "cool", "--service", "Thermostat"}},
           {"`SET_TO_MINIMUM`: the lowest value that the device takes.",
            {"set", "brightness", "minimum", "--service", "Desk Lamp"}},
           {"`SET_TO_MAXIMUM`: the highest.",
            {"set", "brightness", "maximum", "--service", "Desk Lamp"}},
           {"`INCREASE`: from what it is, up to the maximum.",
            {"raise", "brightness", "50", "--service", "Kitchen Ceiling"}},
           {"`DECREASE`: from what it is, down to the minimum.",
            {"lower", "volume", "5", "--service", "Soundbar"}},
           {"`TOGGLE`: off when it is on, on when it is off.",
            {"toggle", "power", "--service", "Desk Lamp"}},
           {"A scene.", {"run", "Soirée"}}}};
}

CommandChapter commandOutcomes() {
  return {
      "How it went: the outcomes of a command",
      "The exit status is 0 for `COMMAND_SUCCESS` and 1 for the others.",
      {{"`COMMAND_SUCCESS`: there is a result.", {"get", "power", "--service", "Desk Lamp"}},
       {"`FOUND_NO_MATCHING_ENTITIES`: no object fits, or none has the attribute.",
        {"get", "brightness", "--room", "Attic"}},
       {"`REQUIRES_UNLOCK`: a device that acts for the unlocked assistant alone. The reply comes "
        "beside that of the results, of which there are none here.",
        {"--locked", "set", "locked", "no", "--service", "Front Door", "--type", "lock"}},
       {"`COMMAND_FAILURE`: the command cannot be done as it is, such as an action that there is "
        "not.",
        {"perform"},
        R"({"filter": {"search": {}}, "actions": [{"actionType": "DANCE"}]})"}}};
}

CommandChapter actionOutcomes() {
  return {"How it went: the outcomes of the objects",
          "",
          {{"`SUCCESS`: the device did it.",
            {"set", "power", "on", "--service", "Sound Lamp", "--home", "Workshop"}},
           {"`UNREACHABLE`: the device does not answer.",
            {"set", "power", "on", "--service", "Lost Lamp", "--home", "Workshop"}},
           {"`READ_ONLY`: the value is not to be set.",
            {"set", "power", "on", "--service", "Sealed Lamp", "--home", "Workshop"}},
           {"`FAILURE`: the device refused it or failed.",
            {"set", "power", "on", "--service", "Broken Lamp", "--home", "Workshop"}},
           {"All at once.", {"set", "power", "on", "--type", "light", "--home", "Workshop"}}}};
}

std::string lamp(const std::string& number, const std::string& name, const std::string& keys,
                 const std::string& properties) {
  return R"(      {"uuid": "9E01A3C4-0000-4000-8000-00000000001)" + number + R"(", "name": ")" +
         name + "\"" + keys + R"(,
       "services": [{"instanceID": 8, "name": ")" +
         name + R"(", "serviceType": "com.corvane.nidus.service.light",
         "characteristics": [{"instanceID": 9, "value": false,
           "characteristicType": "com.corvane.nidus.characteristic.power",
           "properties": [)" +
         properties + R"(], "metadata": {"format": "bool"}}]}]})";
}

}  // namespace

std::vector<CommandChapter> commandChapters() {
  return {filterFields(), actionTypes(), commandOutcomes(), actionOutcomes()};
}

std::string workshopHome() {
  const std::string both = R"("readable", "writable")";
  return R"({"format": "nidus-home/1",
 "homes": [
   {"uuid": "9E01A3C4-0000-4000-8000-000000000010", "name": "Workshop",
    "accessories": [
)" + lamp("1", "Sound Lamp", "", both) +
         ",\n" + lamp("2", "Lost Lamp", R"(, "reachable": false)", both) + ",\n" +
         lamp("3", "Sealed Lamp", "", R"("readable")") + ",\n" +
         lamp("4", "Broken Lamp", R"(, "faults": {"write": 99})", both) + "]}]}\n";
}

}  // namespace nidus
