#include "Assistant/ObjectURL.h"

#include <array>
#include <charconv>
#include <cstring>
#include <memory>

#include "PlatformModel/System/NDNull.h"

namespace nidus {
namespace {

/// The path and the query of one identifier, put together on the stack, so that making a URL
/// allocates the URL alone. The longest, a service's, has 121 characters.
class PathText {
 public:
  PathText& text(std::string_view part) {
    std::memcpy(end_, part.data(), part.size());
    end_ += part.size();
    return *this;
  }

  PathText& number(std::int64_t value) {
    end_ = std::to_chars(end_, characters_.data() + characters_.size(), value).ptr;
    return *this;
  }

  PathText& uuid(const NDUUID& value) {
    value.writeText(end_);
    end_ += NDUUID::kTextLength;
    return *this;
  }

  /// An object that is gone reads as a null does in every text of the plug-in.
  template <class Object>
  PathText& uuidOf(const std::shared_ptr<Object>& object) {
    return object ? uuid(object->uuid()) : text("(null)");
  }

  [[nodiscard]] NDURLRef makeURL() const {
    const auto length = static_cast<std::size_t>(end_ - characters_.data());
    return NDURL::make(kIdentifierScheme, kIdentifierHost, {characters_.data(), length});
  }

 private:
  std::array<char, 128> characters_;
  char* end_ = characters_.data();
};

template <class Object>
NDURLRef urlInHome(std::string_view path, const Object& object) {
  return PathText().text(path).uuid(object.uuid()).text("&home=").uuidOf(object.home()).makeURL();
}

}  // namespace

NDURLRef url(const NDHome& home) {
  return PathText().text("/home?id=").uuid(home.uuid()).makeURL();
}

NDURLRef url(const NDService& service) {
  const std::shared_ptr<NDAccessory> accessory = service.accessory();
  PathText path;
  path.text("/service?id=").number(service.instanceID());
  path.text("&accessory=").uuidOf(accessory);
  path.text("&home=").uuidOf(property(accessory, &NDAccessory::home));
  return path.makeURL();
}

NDURLRef url(const NDRoom& room) { return urlInHome("/room?id=", room); }

NDURLRef url(const NDZone& zone) { return urlInHome("/zone?id=", zone); }

NDURLRef url(const NDServiceGroup& group) { return urlInHome("/group?id=", group); }

NDURLRef url(const NDActionSet& actionSet) { return urlInHome("/actionSet?id=", actionSet); }

NDURLRef url(const NDTrigger& trigger) { return urlInHome("/trigger?id=", trigger); }

}  // namespace nidus
