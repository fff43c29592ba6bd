#include "Support/Refusal.h"

#include <algorithm>
#include <string_view>

#include "PlatformModel/System/NDTextMatching.h"
#include "Support/Finding.h"

namespace nidus {
namespace {

/// More than any message has, the document's name aside, be all that it quotes escaped.
constexpr std::size_t kGreatestLength = 10000;

bool isControl(char32_t codePoint) {
  return codePoint < 0x20 || (codePoint >= 0x7F && codePoint < 0xA0);
}

/// Says what is wrong with a text that is to be shown to people; empty when nothing is.
std::string_view flawOf(std::string_view text) {
  constexpr char32_t kFirstBadByte = 0x110000;
  const std::u32string codePoints = withoutDiacritics(text);
  if (std::any_of(codePoints.begin(), codePoints.end(), isControl)) return "a control character";
  const bool isUTF8 = std::all_of(codePoints.begin(), codePoints.end(),
                                  [](char32_t each) { return each < kFirstBadByte; });
  return isUTF8 ? "" : "bytes that are not UTF-8";
}

}  // namespace

void checkRefusal(const Failure& failure, const std::string& name, Failure::Kind kind) {
  const std::string& message = failure.message;
  const auto complain = [&message](std::string_view what) {
    reportFinding("A refusal " + std::string(what) + ": " + message);
  };
  if (failure.kind != kind) complain("of the wrong kind");
  if (!message.starts_with(name + ": ")) complain("that does not name its document");
  const std::string_view said = std::string_view(message).substr(name.size() + 2);
  if (said.empty()) complain("that says nothing");
  if (said.size() > kGreatestLength) complain("of unlimited length");
  if (const std::string_view flaw = flawOf(said); !flaw.empty()) {
    complain("with " + std::string(flaw));
  }
}

}  // namespace nidus
