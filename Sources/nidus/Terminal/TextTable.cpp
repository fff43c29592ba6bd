#include "nidus/Terminal/TextTable.h"

#include <algorithm>
#include <cstddef>
#include <iterator>
#include <numeric>

namespace nidus {
namespace {

constexpr std::size_t kGapCells = 2;
/// Below this a column says nothing any more.
constexpr std::size_t kNarrowestCells = 6;

std::size_t lineOf(const std::vector<std::size_t>& widths) {
  return std::accumulate(widths.begin(), widths.end(), kGapCells * (widths.size() - 1));
}

/// Takes cells off the widest of the first `shrinking` columns until the table fits.
void shrink(std::vector<std::size_t>& widths, std::ptrdiff_t shrinking, std::size_t columns) {
  while (shrinking > 0 && lineOf(widths) > columns) {
    std::size_t& widest = *std::max_element(widths.begin(), widths.begin() + shrinking);
    if (widest <= kNarrowestCells) return;
    --widest;
  }
}

/// Makes the table fit where it can; the last column gives way last.
void fit(std::vector<std::size_t>& widths, std::size_t columns) {
  if (columns == 0) return;
  const std::ptrdiff_t count = std::ssize(widths);
  shrink(widths, count - 1, columns);
  shrink(widths, count, columns);
}

/// One line of a table, made from left to right.
class TextLine {
 public:
  explicit TextLine(const TerminalStyle& style) : style_(style) {}

  void add(const TextCell& cell, std::size_t width) {
    const std::string text = shortened(cell.text, width);
    if (text.empty()) {
      missingCells_ += width + kGapCells;
      return;
    }
    line_.append(missingCells_, ' ').append(coloured(text, cell.colour, style_));
    missingCells_ = width - cellsOf(text) + kGapCells;
  }
  /// Without blanks at the end.
  [[nodiscard]] std::string text() const { return line_ + '\n'; }

 private:
  const TerminalStyle& style_;
  std::string line_;
  std::size_t missingCells_ = 0;
};

}  // namespace

std::vector<std::size_t> TextTable::columnsInUse() const {
  std::vector<std::size_t> columns;
  for (std::size_t column = 0; column < titles_.size(); ++column) {
    const auto isUsed = [column](const auto& row) { return !row[column].text.empty(); };
    if (std::any_of(rows_.begin(), rows_.end(), isUsed)) columns.push_back(column);
  }
  return columns;
}

std::size_t TextTable::widthOf(std::size_t column) const {
  std::size_t width = cellsOf(titles_[column]);
  for (const auto& row : rows_) width = std::max(width, cellsOf(row[column].text));
  return width;
}

std::string TextTable::text(const TerminalStyle& style) const {
  if (rows_.empty()) return {};
  const std::vector<std::size_t> columns = columnsInUse();
  std::vector<std::size_t> widths;
  widths.reserve(columns.size());
  for (const std::size_t column : columns) widths.push_back(widthOf(column));
  fit(widths, style.columns);
  TextLine titles(style);
  for (std::size_t i = 0; i < columns.size(); ++i) {
    titles.add({titles_[columns[i]], Colour::title}, widths[i]);
  }
  std::string text = titles.text();
  for (const auto& row : rows_) {
    TextLine line(style);
    for (std::size_t i = 0; i < columns.size(); ++i) line.add(row[columns[i]], widths[i]);
    text += line.text();
  }
  return text;
}

}  // namespace nidus
