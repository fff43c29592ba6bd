#include "Assistant/ObjectLookUp.h"

#include <algorithm>
#include <charconv>
#include <cstdint>
#include <optional>
#include <stdexcept>
#include <string_view>
#include <utility>

#include "Assistant/ObjectURL.h"
#include "Assistant/ServiceLookUp.h"
#include "PlatformModel/Home/NDLookUp.h"
#include "PlatformModel/System/NDNull.h"

namespace nidus {
namespace {

constexpr bool isSeparator(char c) noexcept { return c == ':' || c == '&' || c == '=' || c == '?'; }

/// Where the first token that equals `key` begins; `npos` without one. Tokens are what stands
/// between separators, and a key has none.
std::size_t findKey(std::string_view query, std::string_view key) noexcept {
  for (std::size_t at = query.find(key); at != std::string_view::npos;
       at = query.find(key, at + 1)) {
    const std::size_t end = at + key.size();
    const bool begins = at == 0 || isSeparator(query[at - 1]);
    if (begins && (end == query.size() || isSeparator(query[end]))) return at;
  }
  return std::string_view::npos;
}

/// Puts the token after the first `key` into `value`; false, and nothing done, without the key.
template <class Text>
bool readKey(std::string_view query, std::string_view key, Text& value) {
  const std::size_t at = findKey(query, key);
  if (at == std::string_view::npos) return false;
  const std::size_t end = at + key.size();
  if (end == query.size()) throw std::out_of_range("An identifier ends with a key");
  query.remove_prefix(end + 1);
  const auto* const valueEnd = std::find_if(query.begin(), query.end(), isSeparator);
  value = query.substr(0, static_cast<std::size_t>(valueEnd - query.begin()));
  return true;
}

template <class Text>
void readParts(const NDURL& identifier, Text& kind, Text& objectID, Text& home, Text& accessory) {
  kind = identifier.pathComponent(1);
  const std::string_view query = identifier.queryView().value_or(std::string_view());
  readKey(query, "id", objectID);
  readKey(query, "home", home);
  if (!readKey(query, "accessory", accessory)) readKey(query, "ActionSet", accessory);
}

/// The four outputs of `splitIdentifier` in the URL's own text; what is missing is empty, which
/// names no object either.
struct Identifier {
  explicit Identifier(const NDURL& url) { readParts(url, kind, id, home, accessory); }
  std::string_view kind;
  std::string_view id;
  std::string_view home;
  std::string_view accessory;
};

std::optional<std::int64_t> numberFrom(std::string_view digits) {
  const char* const end = digits.data() + digits.size();
  std::int64_t number = 0;
  const auto [stop, error] = std::from_chars(digits.data(), end, number);
  if (error != std::errc() || stop != end) return std::nullopt;
  return number;
}

NDArray<NDHome> homesOf(const std::shared_ptr<NDAssistantGather>& gather) {
  return property(property(gather, &NDAssistantGather::manager), &NDHomeManager::homes);
}

}  // namespace

void splitIdentifier(const NDURL& identifier, NDString& kind, NDString& objectID, NDString& home,
                     NDString& accessory) {
  if (identifier.scheme() != kIdentifierScheme) {
    // A foreign scheme clears the outputs and is read all the same.
    objectID = kind = home = accessory = nullptr;
  }
  readParts(identifier, kind, objectID, home, accessory);
}

ServiceLookUp::ServiceLookUp(std::shared_ptr<NDAssistantGather> gather)
    : gather_(std::move(gather)) {}

std::shared_ptr<NDService> ServiceLookUp::service(const HomeObjectRecord& record) {
  if (!record.objectIdentifier) return nullptr;
  const Identifier identifier(record.objectIdentifier);
  const auto home = homes_.find(homesOf(gather_), NDUUID::fromText(identifier.home));
  if (!home) return nullptr;
  const auto accessory =
      accessories_[home.get()].find(home->accessories(), NDUUID::fromText(identifier.accessory));
  if (!accessory) return nullptr;
  return services_.find(accessory->services(), numberFrom(identifier.id));
}

std::shared_ptr<NDService> serviceFromObject(const HomeObjectRecord& record,
                                             const std::shared_ptr<NDAssistantGather>& gather) {
  return ServiceLookUp(gather).service(record);
}

std::shared_ptr<NDActionSet> actionSetFromObject(const HomeObjectRecord& record,
                                                 const std::shared_ptr<NDAssistantGather>& gather) {
  if (!record.objectIdentifier) return nullptr;
  const Identifier identifier(record.objectIdentifier);
  const auto home = findInArrayByUUID(homesOf(gather), NDUUID::fromText(identifier.home));
  return findInArrayByUUID(property(home, &NDHome::actionSets), NDUUID::fromText(identifier.id));
}

}  // namespace nidus
