#include "Assistant/ObjectLookUp.h"

#include <algorithm>
#include <charconv>
#include <cstdint>
#include <optional>
#include <string_view>
#include <vector>

#include "Assistant/ObjectURL.h"
#include "PlatformModel/Home/NDLookUp.h"
#include "PlatformModel/System/NDNull.h"

namespace nidus {
namespace {

using Tokens = std::vector<std::string_view>;

/// The four outputs of `splitIdentifier`.
struct Identifier {
  explicit Identifier(const NDURLRef& url) { splitIdentifier(url, kind, id, home, accessory); }
  NDString kind;
  NDString id;
  NDString home;
  NDString accessory;
};

/// Splits at every separator, so that neighbours enclose an empty token.
Tokens tokensOf(std::string_view query) {
  Tokens tokens;
  for (;;) {
    const std::size_t end = query.find_first_of(":&=?");
    tokens.push_back(query.substr(0, end));
    if (end == std::string_view::npos) return tokens;
    query.remove_prefix(end + 1);
  }
}

/// Puts the token after the first `key` into `value`; false, and nothing done, without the key.
bool readKey(const Tokens& tokens, std::string_view key, NDString& value) {
  const auto found = std::find(tokens.begin(), tokens.end(), key);
  if (found == tokens.end()) return false;
  value = tokens.at(static_cast<std::size_t>(found - tokens.begin()) + 1);
  return true;
}

std::optional<std::int64_t> numberFrom(const NDString& text) {
  const std::string_view digits = text.view();
  const char* const end = digits.data() + digits.size();
  std::int64_t number = 0;
  const auto [stop, error] = std::from_chars(digits.data(), end, number);
  if (error != std::errc() || stop != end) return std::nullopt;
  return number;
}

std::shared_ptr<NDHome> homeOf(const Identifier& identifier,
                               const std::shared_ptr<NDAssistantGather>& gather) {
  const auto manager = property(gather, &NDAssistantGather::manager);
  return findInArrayByUUID(property(manager, &NDHomeManager::homes),
                           NDUUID::fromText(identifier.home.view()));
}

}  // namespace

void splitIdentifier(const NDURLRef& identifier, NDString& kind, NDString& objectID, NDString& home,
                     NDString& accessory) {
  if (identifier->scheme() != kIdentifierScheme) {
    // A foreign scheme clears the outputs and is read all the same.
    objectID = kind = home = accessory = nullptr;
  }
  kind = identifier->pathComponents().at(1);
  const NDString query = identifier->query();  // A URL without one has the tokens of no text.
  const Tokens tokens = tokensOf(query.view());
  readKey(tokens, "id", objectID);
  readKey(tokens, "home", home);
  if (!readKey(tokens, "accessory", accessory)) readKey(tokens, "ActionSet", accessory);
}

std::shared_ptr<NDService> serviceFromObject(const HomeObjectRecord& record,
                                             const std::shared_ptr<NDAssistantGather>& gather) {
  if (!record.objectIdentifier) return nullptr;
  const Identifier identifier(record.objectIdentifier);
  const auto home = homeOf(identifier, gather);
  const auto accessory = findInArrayByUUID(property(home, &NDHome::accessories),
                                           NDUUID::fromText(identifier.accessory.view()));
  return findInArrayByInstanceID(property(accessory, &NDAccessory::services),
                                 numberFrom(identifier.id));
}

std::shared_ptr<NDActionSet> actionSetFromObject(const HomeObjectRecord& record,
                                                 const std::shared_ptr<NDAssistantGather>& gather) {
  if (!record.objectIdentifier) return nullptr;
  const Identifier identifier(record.objectIdentifier);
  const auto home = homeOf(identifier, gather);
  return findInArrayByUUID(property(home, &NDHome::actionSets),
                           NDUUID::fromText(identifier.id.view()));
}

}  // namespace nidus
