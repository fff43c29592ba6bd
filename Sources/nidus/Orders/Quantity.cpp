#include "nidus/Orders/Quantity.h"

#include <algorithm>
#include <array>
#include <cstddef>
#include <string_view>

#include "PlatformModel/Home/NDCharacteristicConstants.h"
#include "nidus/Orders/WordChoice.h"

namespace nidus {
namespace {

struct UnitSign {
  std::string_view sign;
  std::string_view unit;
};

constexpr std::array<UnitSign, 8> kSigns = {{
    {"%", NDCharacteristicMetadataUnitsPercentage},
    {"PERCENT", NDCharacteristicMetadataUnitsPercentage},
    {"C", NDCharacteristicMetadataUnitsCelsius},
    {"°C", NDCharacteristicMetadataUnitsCelsius},
    {"F", NDCharacteristicMetadataUnitsFahrenheit},
    {"°F", NDCharacteristicMetadataUnitsFahrenheit},
    {"°", NDCharacteristicMetadataUnitsArcDegree},
    {"LX", "lux"},
}};

/// The platform's name of a unit; null for one that there is not.
NDString unitNamed(std::string_view name, const Vocabulary& vocabulary) {
  const std::string word = vocabularyWord(name);
  for (const UnitSign& known : kSigns) {
    if (known.sign == word) return known.unit;
  }
  for (const UnitEntry& known : vocabulary.units) {
    if (vocabularyWord(known.assistantName.view()) == word) return known.unit;
  }
  return nullptr;
}

bool isDigit(char c) { return c >= '0' && c <= '9'; }

/// How many characters at the start of `text` are a decimal number, its sign included.
std::size_t lengthOfNumber(std::string_view text) {
  std::size_t length = !text.empty() && (text[0] == '-' || text[0] == '+') ? 1 : 0;
  const auto skipDigits = [text, &length] {
    const std::size_t start = length;
    while (length < text.size() && isDigit(text[length])) ++length;
    return length - start;
  };
  std::size_t digits = skipDigits();
  if (length + 1 < text.size() && text[length] == '.' && isDigit(text[length + 1])) {
    ++length;
    digits += skipDigits();
  }
  return digits == 0 ? 0 : length;
}

}  // namespace

std::optional<Quantity> readQuantity(const std::string& text, const Vocabulary& vocabulary) {
  const std::size_t length = lengthOfNumber(text);
  if (length == 0) return std::nullopt;
  const std::size_t sign = text[0] == '+' ? 1 : 0;
  Quantity quantity{text.substr(sign, length - sign), nullptr};
  const std::size_t unit = text.find_first_not_of(' ', length);
  if (unit == std::string::npos) return quantity;
  quantity.unit = unitNamed(std::string_view(text).substr(unit), vocabulary);
  if (!quantity.unit) return std::nullopt;
  return quantity;
}

}  // namespace nidus
