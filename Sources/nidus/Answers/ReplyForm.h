#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "PlatformModel/System/NDDictionary.h"

namespace nidus {

/// What a reply says about one object. Texts are ready to be shown on one line; what the reply
/// leaves out is empty.
struct ObjectResult {
  std::string name;
  std::string room;
  std::string home;
  std::string type;     ///< "LIGHT"; the entity type of what is no service: "SCENE".
  std::string outcome;  ///< "SUCCESS", "UNREACHABLE", ...
  NDDictionary value;   ///< As `{"integer": 65, "units": "PERCENTAGE"}`.

  [[nodiscard]] bool isSuccess() const;
  /// The name, or that there is none.
  [[nodiscard]] std::string nameText() const { return name.empty() ? "(no name)" : name; }
};

/// A reply in a form to work with.
struct ReplyForm {
  std::string outcome;
  std::vector<ObjectResult> results;
};

/// Reads a reply as the plug-in gives it; what is not there, or not of its type, is left empty.
[[nodiscard]] ReplyForm replyForm(const NDDictionary& reply);

/// The text of `key`; empty when there is none.
[[nodiscard]] std::string textAt(const NDDictionary& dictionary, std::string_view key);

}  // namespace nidus
