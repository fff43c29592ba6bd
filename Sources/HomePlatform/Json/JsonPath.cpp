#include "HomePlatform/Json/JsonPath.h"

namespace nidus {

void appendPointerStep(std::string& place, std::string_view key) {
  place += '/';
  for (const char c : key) {
    if (c == '~') {
      place += "~0";
    } else if (c == '/') {
      place += "~1";
    } else {
      place += c;
    }
  }
}

std::string JsonPath::place() const {
  std::string place = base_;
  for (const Step& step : steps_) {
    if (step.isArray) {
      appendPointerStep(place, std::to_string(step.index));
    } else if (step.isNamed) {
      appendPointerStep(place, step.key);
    }
  }
  return place;
}

}  // namespace nidus
