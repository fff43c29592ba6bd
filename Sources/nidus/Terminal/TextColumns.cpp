#include "nidus/Terminal/TextColumns.h"

#include <algorithm>

#include "nidus/Terminal/Terminal.h"

namespace nidus {

std::string inColumns(const std::vector<std::string>& texts, std::size_t cells) {
  constexpr std::size_t kGap = 2;
  std::size_t width = 0;
  for (const std::string& text : texts) width = std::max(width, cellsOf(text) + kGap);
  const std::size_t columns = std::max<std::size_t>(1, width == 0 ? 1 : (cells + kGap) / width);
  const std::size_t rows = (texts.size() + columns - 1) / columns;
  std::string lines;
  for (std::size_t row = 0; row < rows; ++row) {
    for (std::size_t i = row; i < texts.size(); i += rows) {
      lines += texts[i];
      const bool isLast = i + rows >= texts.size();
      if (!isLast) lines.append(width - cellsOf(texts[i]), ' ');
    }
    lines += '\n';
  }
  return lines;
}

}  // namespace nidus
