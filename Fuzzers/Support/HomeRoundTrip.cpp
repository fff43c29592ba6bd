#include "Support/HomeRoundTrip.h"

#include <sstream>

#include "HomePlatform/HomePlatform.h"
#include "HomePlatform/Store/HomeDocument.h"
#include "Support/DataText.h"
#include "Support/Finding.h"

namespace nidus {
namespace {

std::string written(const std::vector<HomeData>& homes, bool indent) {
  std::ostringstream out;
  writeHomeDocument(out, homes, indent);
  return out.str();
}

std::vector<HomeData> readBack(const std::string& document) {
  std::istringstream in(document);
  auto homes = readHomeDocument(in, "written");
  if (!homes) {
    reportFinding("A document that was written is refused: " + homes.failure().message + '\n' +
                  document);
  }
  return std::move(*homes);
}

std::vector<HomeData> throughDatabase(const std::vector<HomeData>& homes) {
  HomePlatformOptions options;
  options.drainsOnCaller = true;
  options.homes = homes;
  options.vocabulary = Vocabulary();  // quicker than the built-in one, and no home needs it
  const auto platform = HomePlatform::open(std::move(options));
  if (!platform) reportFinding("The database refuses homes: " + platform.failure().message);
  auto exported = (*platform)->exportHomes();
  if (!exported) reportFinding("Homes cannot be exported: " + exported.failure().message);
  return std::move(*exported);
}

}  // namespace

std::string homeDocumentOf(const std::vector<HomeData>& homes) { return written(homes, true); }

void checkHomesSurvive(const std::vector<HomeData>& homes) {
  const std::string expected = dataText(homes);
  expectSameText("Homes change when they are written and read", expected,
                 dataText(readBack(written(homes, true))));
  expectSameText("Homes change when they are written on one line and read", expected,
                 dataText(readBack(written(homes, false))));
  expectSameText("Homes change in the database", expected, dataText(throughDatabase(homes)));
}

}  // namespace nidus
