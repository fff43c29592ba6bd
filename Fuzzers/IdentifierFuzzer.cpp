#include <fuzzer/FuzzedDataProvider.h>

#include <algorithm>
#include <memory>
#include <stdexcept>

#include "Assistant/ObjectLookUp.h"
#include "Assistant/ObjectURL.h"
#include "HomePlatform/Objects/HomeObject.h"
#include "PlatformModel/Home/NDLookUp.h"
#include "Support/Finding.h"

// Identifiers: the URL of each kind of object, whatever its UUIDs and numbers are, splits into what
// it was made of. Any other text is split or refused as out of range, and finds no object.

namespace nidus {
namespace {

NDUUID takeUUID(FuzzedDataProvider& input) {
  std::array<std::uint8_t, 16> bytes{};
  input.ConsumeData(bytes.data(), bytes.size());
  return NDUUID(bytes);
}

HomeData takeHome(FuzzedDataProvider& input) {
  HomeData home;
  home.uuid = takeUUID(input);
  home.name = "Home";
  home.accessories.resize(1);
  home.accessories[0].uuid = takeUUID(input);
  home.accessories[0].name = "Accessory";
  home.accessories[0].services.resize(1);
  home.accessories[0].services[0].instanceID = input.ConsumeIntegral<std::int64_t>();
  const NDUUID object = takeUUID(input);
  home.rooms = {{object, "Room"}};
  home.zones = {{object, "Zone", {}}};
  home.serviceGroups = {{object, "Group", {}}};
  home.actionSets = {{object, "Scene", {}}};
  home.triggers = {{object, "Trigger"}};
  return home;
}

/// What is to be read out of a URL; null for what it does not say.
struct Parts {
  NDString kind;
  NDString id;
  NDString home;
  NDString accessory;
  friend bool operator==(const Parts&, const Parts&) = default;
};

Parts split(const NDURL& url) {
  Parts parts;
  splitIdentifier(url, parts.kind, parts.id, parts.home, parts.accessory);
  return parts;
}

void expectParts(const NDURL& url, const Parts& expected) {
  if (!(split(url) == expected)) reportFinding("A URL does not say its parts: " + url.text().str());
}

/// The URL of an object in a home says the home, and the object by its UUID.
template <class Object>
void checkObject(const char* kind, const Object& object) {
  expectParts(url(object),
              {kind, object.uuid().UUIDString(), object.home()->uuid().UUIDString(), nullptr});
  if (NDUUID::fromText(split(url(object)).id.view()) != object.uuid()) {
    reportFinding("A UUID does not survive its text: " + object.uuid().UUIDString().str());
  }
}

void checkService(const NDHome& home, const std::shared_ptr<NDService>& service) {
  const NDURL address = url(*service);
  const Parts parts = split(address);
  expectParts(address, {"service", std::to_string(service->instanceID()), home.uuid().UUIDString(),
                        service->accessory()->uuid().UUIDString()});
  const auto accessory =
      findInArrayByUUID(home.accessories(), NDUUID::fromText(parts.accessory.view()));
  if (!accessory) reportFinding("A service's accessory is not found: " + address.text().str());
}

void checkHome(const HomeData& data) {
  const auto home = HomeObject::make(std::make_shared<const HomeData>(data), {});
  expectParts(url(*home), {"home", home->uuid().UUIDString(), nullptr, nullptr});
  checkService(*home, home->accessories()[0]->services()[0]);
  checkObject("room", *home->rooms()[0]);
  checkObject("zone", *home->zones()[0]);
  checkObject("group", *home->serviceGroups()[0]);
  checkObject("actionSet", *home->actionSets()[0]);
  checkObject("trigger", *home->triggers()[0]);
}

/// A URL of the program, changed here and there, or any text.
std::string takeText(FuzzedDataProvider& input, const HomeData& data) {
  if (input.ConsumeBool()) return input.ConsumeRemainingBytesAsString();
  const auto home = HomeObject::make(std::make_shared<const HomeData>(data), {});
  std::string text = url(*home->accessories()[0]->services()[0]).text().str();
  while (input.remaining_bytes() > 0 && !text.empty()) {
    const auto at = input.ConsumeIntegralInRange<std::size_t>(0, text.size() - 1);
    const auto length = input.ConsumeIntegralInRange<std::size_t>(0, 8);
    text.replace(at, length, input.ConsumeRandomLengthString(8));
  }
  return text;
}

void checkAnyURL(const NDURL& any) {
  const NDString scheme = any.scheme();
  if (scheme && !any.text().view().starts_with(scheme.str() + ':')) {
    reportFinding("A URL does not begin with its scheme: " + any.text().str());
  }
  const NDString query = any.query();
  if (query && any.text().view().find('?' + query.str()) == std::string_view::npos) {
    reportFinding("A URL does not have its query: " + any.text().str());
  }
  HomeObjectRecord record;
  record.objectIdentifier = any;
  try {
    if (serviceFromObject(record, nullptr) || actionSetFromObject(record, nullptr)) {
      reportFinding("An object is found without homes: " + any.text().str());
    }
  } catch (const std::out_of_range&) {
    return;  // what is promised for a path or a query that ends too soon
  }
}

}  // namespace
}  // namespace nidus

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  FuzzedDataProvider input(data, size);
  const nidus::HomeData home = nidus::takeHome(input);
  nidus::checkHome(home);
  nidus::checkAnyURL(nidus::NDURL::fromText(nidus::takeText(input, home)));
  return 0;
}
