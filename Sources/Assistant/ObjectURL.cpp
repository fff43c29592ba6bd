#include "Assistant/ObjectURL.h"

#include <array>
#include <charconv>
#include <cstring>
#include <memory>

#include "PlatformModel/System/NDNull.h"

namespace nidus {
namespace {

/// One identifier, put together on the stack, so that making a URL allocates the URL alone. The
/// longest, a service's, has 144 characters.
class URLText {
 public:
  explicit URLText(std::string_view path) {
    text(kIdentifierScheme).text("://").text(kIdentifierHost).text(path);
  }

  URLText& text(std::string_view part) {
    std::memcpy(end_, part.data(), part.size());
    end_ += part.size();
    return *this;
  }

  URLText& number(std::int64_t value) {
    end_ = std::to_chars(end_, characters_.data() + characters_.size(), value).ptr;
    return *this;
  }

  URLText& uuid(const NDUUID& value) {
    value.writeText(end_);
    end_ += NDUUID::kTextLength;
    return *this;
  }

  /// An object that is gone reads as a null does in every text of the plug-in.
  template <class Pointer>
  URLText& uuidOf(const Pointer& object) {
    return object ? uuid(object->uuid()) : text("(null)");
  }

  [[nodiscard]] NDURL makeURL() const {
    const auto length = static_cast<std::size_t>(end_ - characters_.data());
    return NDURL::fromText(std::string_view(characters_.data(), length));
  }

 private:
  std::array<char, 160> characters_;
  char* end_ = characters_.data();
};

template <class Object>
NDURL urlInHome(std::string_view path, const Object& object) {
  const std::shared_ptr<NDHome> home = object.home();
  return URLText(path).uuid(object.uuid()).text("&home=").uuidOf(home).makeURL();
}

}  // namespace

NDURL url(const NDHome& home) { return URLText("/home?id=").uuid(home.uuid()).makeURL(); }

NDURL url(const NDService& service) {
  const std::shared_ptr<NDAccessory> accessory = service.accessory();
  const std::shared_ptr<NDHome> home = property(accessory, &NDAccessory::home);
  return url(service, accessory.get(), home.get());
}

NDURL url(const NDService& service, const NDAccessory* accessory, const NDHome* home) {
  URLText text("/service?id=");
  text.number(service.instanceID());
  text.text("&accessory=").uuidOf(accessory);
  text.text("&home=").uuidOf(home);
  return text.makeURL();
}

NDURL url(const NDRoom& room) { return urlInHome("/room?id=", room); }

NDURL url(const NDZone& zone) { return urlInHome("/zone?id=", zone); }

NDURL url(const NDServiceGroup& group) { return urlInHome("/group?id=", group); }

NDURL url(const NDActionSet& actionSet) { return urlInHome("/actionSet?id=", actionSet); }

NDURL url(const NDTrigger& trigger) { return urlInHome("/trigger?id=", trigger); }

}  // namespace nidus
