#include "HomePlatform/Store/HomePartReader.h"

#include <array>
#include <limits>
#include <utility>

#include "HomePlatform/Store/HomeChecks.h"
#include "HomePlatform/Store/ValueConversion.h"

namespace nidus {
namespace {

constexpr std::int64_t kGreatestInteger = std::numeric_limits<std::int64_t>::max();

std::int64_t instanceID(const JsonPlaced& value) { return value.integer(1, kGreatestInteger); }

bool booleanOr(const std::optional<JsonPlaced>& value, bool otherwise) {
  return value ? value->boolean() : otherwise;
}

std::int32_t faultCode(const std::optional<JsonPlaced>& code) {
  if (!code) return 0;
  using Limits = std::numeric_limits<std::int32_t>;
  const auto number = static_cast<std::int32_t>(code->integer(Limits::min(), Limits::max()));
  if (number == 0) code->fail("expected an error code other than 0");
  return number;
}

FaultData faults(JsonObject& owner) {
  const auto value = owner.optional("faults");
  if (!value) return {};
  JsonObject object(*value);
  const FaultData faults{.read = faultCode(object.optional("read")),
                         .write = faultCode(object.optional("write"))};
  object.refuseUnknownKeys();
  return faults;
}

/// The objects that have a UUID and a name, and nothing else that is read the same way.
template <class Data>
Data named(JsonObject& object) {
  Data data;
  data.uuid = object.required("uuid").uuid();
  data.name = object.required("name").text();
  return data;
}

/// A reader that appends what it has read to a list.
template <class Data>
class ElementReader : public HomePartReader {
 public:
  ElementReader(std::vector<Data>& list, SharedTexts& texts) : texts_(texts), list_(list) {}

 protected:
  template <class Reader, class Element>
  void addList(std::string_view key, std::vector<Element>& elements) {
    lists_.push_back(
        {key, [&elements, &texts = texts_] { return std::make_unique<Reader>(elements, texts); }});
  }

  NDString sharedText(const std::optional<JsonPlaced>& value) {
    return value ? texts_.text(value->text()) : NDString();
  }

  SharedTexts& texts_;
  std::vector<Data>& list_;
};

template <class Data>
class NamedReader final : public ElementReader<Data> {
 public:
  using ElementReader<Data>::ElementReader;
  void finish(JsonObject& object) override { this->list_.push_back(named<Data>(object)); }
};

class ZoneReader final : public ElementReader<ZoneData> {
 public:
  using ElementReader::ElementReader;
  void finish(JsonObject& object) override {
    auto zone = named<ZoneData>(object);
    if (const auto rooms = object.optional("rooms")) {
      for (const JsonPlaced& room : rooms->array()) zone.rooms.push_back(room.uuid());
    }
    list_.push_back(std::move(zone));
  }
};

class CharacteristicReader final : public ElementReader<CharacteristicData> {
 public:
  using ElementReader::ElementReader;
  void finish(JsonObject& object) override {
    CharacteristicData data;
    data.instanceID = instanceID(object.required("instanceID"));
    data.characteristicType = sharedText(object.required("characteristicType"));
    data.properties = properties(object.optional("properties"));
    const auto value = object.optional("value");
    const auto deviceValue = object.optional("deviceValue");
    data.metadata = metadata(object.optional("metadata"));
    const NDString format = data.metadata ? data.metadata->format : NDString();
    data.value = converted(value, format);
    data.deviceValue = deviceValue ? converted(deviceValue, format) : data.value;
    data.faults = faults(object);
    list_.push_back(std::move(data));
  }

 private:
  std::vector<NDString> properties(const std::optional<JsonPlaced>& value) {
    std::vector<NDString> words;
    if (!value) return words;
    for (const JsonPlaced& word : value->array()) {
      const std::string& text = word.text();
      if (text != "readable" && text != "writable" && text != "notifies") {
        word.fail("expected \"readable\", \"writable\" or \"notifies\"");
      }
      words.push_back(texts_.text(text));
    }
    return words;
  }

  std::optional<MetadataData> metadata(const std::optional<JsonPlaced>& value) {
    if (!value) return std::nullopt;
    JsonObject object(*value);
    MetadataData data;
    data.format = sharedText(object.optional("format"));
    data.units = sharedText(object.optional("units"));
    data.minimumValue = converted(object.optional("minimumValue"), data.format);
    data.maximumValue = converted(object.optional("maximumValue"), data.format);
    data.stepValue = converted(object.optional("stepValue"), data.format);
    object.refuseUnknownKeys();
    return data;
  }

  static NDValueRef converted(const std::optional<JsonPlaced>& value, const NDString& format) {
    if (!value) return nullptr;
    NDValueRef boxed = convertToFormat(value->boxed(), format);
    if (!boxed) value->fail("expected a value that fits the format \"" + format.str() + '"');
    return boxed;
  }
};

class ServiceReader final : public ElementReader<ServiceData> {
 public:
  ServiceReader(std::vector<ServiceData>& list, SharedTexts& texts) : ElementReader(list, texts) {
    addList<CharacteristicReader>("characteristics", data_.characteristics);
  }
  void finish(JsonObject& object) override {
    data_.instanceID = instanceID(object.required("instanceID"));
    if (const auto name = object.optional("name")) data_.name = name->text();
    data_.serviceType = sharedText(object.required("serviceType"));
    data_.associatedServiceType = sharedText(object.optional("associatedServiceType"));
    data_.characteristics.shrink_to_fit();
    list_.push_back(std::move(data_));
  }

 private:
  ServiceData data_;
};

class AccessoryReader final : public ElementReader<AccessoryData> {
 public:
  AccessoryReader(std::vector<AccessoryData>& list, SharedTexts& texts)
      : ElementReader(list, texts) {
    addList<ServiceReader>("services", services_);
  }
  void finish(JsonObject& object) override {
    auto data = named<AccessoryData>(object);
    if (const auto room = object.optional("room")) data.room = room->uuid();
    data.reachable = booleanOr(object.optional("reachable"), true);
    data.requiresUnlock = booleanOr(object.optional("requiresUnlock"), false);
    services_.shrink_to_fit();
    data.services = std::move(services_);
    data.faults = faults(object);
    list_.push_back(std::move(data));
  }

 private:
  std::vector<ServiceData> services_;
};

class GroupMemberReader final : public ElementReader<ServiceAddress> {
 public:
  using ElementReader::ElementReader;
  void finish(JsonObject& object) override {
    list_.push_back({.accessory = object.required("accessory").uuid(),
                     .service = instanceID(object.required("service"))});
  }
};

class ServiceGroupReader final : public ElementReader<ServiceGroupData> {
 public:
  ServiceGroupReader(std::vector<ServiceGroupData>& list, SharedTexts& texts)
      : ElementReader(list, texts) {
    addList<GroupMemberReader>("services", services_);
  }
  void finish(JsonObject& object) override {
    auto data = named<ServiceGroupData>(object);
    data.services = std::move(services_);
    list_.push_back(std::move(data));
  }

 private:
  std::vector<ServiceAddress> services_;
};

class SceneActionReader final : public ElementReader<SceneActionData> {
 public:
  using ElementReader::ElementReader;
  void finish(JsonObject& object) override {
    SceneActionData data;
    data.target.accessory = object.required("accessory").uuid();
    data.target.service = instanceID(object.required("service"));
    data.target.characteristic = instanceID(object.required("characteristic"));
    data.value = object.required("value").boxed();
    list_.push_back(std::move(data));
  }
};

class ActionSetReader final : public ElementReader<ActionSetData> {
 public:
  ActionSetReader(std::vector<ActionSetData>& list, SharedTexts& texts)
      : ElementReader(list, texts) {
    addList<SceneActionReader>("actions", actions_);
  }
  void finish(JsonObject& object) override {
    auto data = named<ActionSetData>(object);
    data.actions = std::move(actions_);
    if (const auto value = object.optional("faults")) {
      JsonObject fault(*value);
      data.executeFault = faultCode(fault.optional("execute"));
      fault.refuseUnknownKeys();
    }
    list_.push_back(std::move(data));
  }

 private:
  std::vector<SceneActionData> actions_;
};

class HomeReader final : public ElementReader<HomeData> {
 public:
  HomeReader(std::vector<HomeData>& list, SharedTexts& texts) : ElementReader(list, texts) {
    addList<NamedReader<RoomData>>("rooms", data_.rooms);
    addList<ZoneReader>("zones", data_.zones);
    addList<AccessoryReader>("accessories", data_.accessories);
    addList<ServiceGroupReader>("serviceGroups", data_.serviceGroups);
    addList<ActionSetReader>("actionSets", data_.actionSets);
    addList<NamedReader<TriggerData>>("triggers", data_.triggers);
  }
  void finish(JsonObject& object) override {
    data_.uuid = object.required("uuid").uuid();
    data_.name = object.required("name").text();
    data_.primary = booleanOr(object.optional("primary"), false);
    data_.faults = faults(object);
    checkHome(data_, object.placed().place());
    list_.push_back(std::move(data_));
  }

 private:
  HomeData data_;
};

class DocumentReader final : public ElementReader<HomeData> {
 public:
  DocumentReader(std::vector<HomeData>& homes, SharedTexts& texts) : ElementReader(homes, texts) {
    addList<HomeReader>("homes", homes);
  }
  /// A document of another format is said to be one before its other keys are found fault with.
  void see(std::string_view key, const JsonValue& value, const JsonPath& path) override {
    if (key == "format") checkFormat(JsonPlaced(value, path.place()));
  }
  void finish(JsonObject& object) override {
    checkFormat(object.required("format"));
    (void)object.required("homes").array();
    checkHomesAreUnique(list_, object.placed().place());
  }

 private:
  static void checkFormat(const JsonPlaced& format) {
    if (format.text() != "nidus-home/1") format.fail("expected \"nidus-home/1\"");
  }
};

}  // namespace

std::unique_ptr<HomePartReader> makeDocumentReader(std::vector<HomeData>& homes,
                                                   SharedTexts& texts) {
  return std::make_unique<DocumentReader>(homes, texts);
}

}  // namespace nidus
