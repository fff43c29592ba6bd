#include <optional>
#include <sstream>

#include "HomePlatform/Json/JsonReader.h"
#include "HomePlatform/Store/HomeDocument.h"
#include "Support/DataText.h"
#include "Support/Finding.h"
#include "Support/HomeRoundTrip.h"
#include "Support/Refusal.h"

// Home documents: what is refused is refused well, what is read survives, and a document within
// another one is read as it is on its own.

namespace nidus {
namespace {

std::optional<std::vector<HomeData>> readAsPart(std::string_view text) {
  try {
    std::vector<HomeData> homes;
    readJson(text, *makeHomeDocumentEvents(homes), kHomeDocumentLimits);
    return homes;
  } catch (const JsonError&) {
    return std::nullopt;
  }
}

void tryDocument(const std::string& text) {
  std::istringstream in(text);
  const auto homes = readHomeDocument(in, "home.json");
  const auto asPart = readAsPart(text);
  if (asPart.has_value() != static_cast<bool>(homes)) {
    reportFinding("A document is read on its own or within another one, but not both.");
  }
  if (!homes) return checkRefusal(homes.failure(), "home.json");
  expectSameText("A document differs within another one", dataText(*homes), dataText(*asPart));
  checkHomesSurvive(*homes);
}

}  // namespace
}  // namespace nidus

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  nidus::tryDocument(std::string(nidus::textOf(data, size)));
  return 0;
}
