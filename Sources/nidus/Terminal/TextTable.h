#pragma once

#include <cstddef>
#include <string>
#include <utility>
#include <vector>

#include "nidus/Terminal/Terminal.h"

namespace nidus {

/// One field of a table, on one line.
struct TextCell {
  // NOLINTBEGIN(google-explicit-constructor): a plain text is a cell
  TextCell(std::string cellText, Colour cellColour = Colour::none)
      : text(std::move(cellText)), colour(cellColour) {}
  TextCell(const char* cellText, Colour cellColour = Colour::none)
      : text(cellText), colour(cellColour) {}
  // NOLINTEND(google-explicit-constructor)

  std::string text;
  Colour colour;
};

/// A table of text under titles. Its columns are as wide as what stands in them; where that is more
/// than the terminal has, the widest ones are shortened, the last one only when nothing else helps.
/// A column in which nothing stands is left out.
///
///     TextTable table({"OBJECT", "ROOM"});
///     table.addRow({lamp.name, lamp.room});
///     printText(table.text(standardOutputStyle()));
class TextTable {
 public:
  explicit TextTable(std::vector<std::string> titles) : titles_(std::move(titles)) {}

  /// Adds a row; it has one cell for each title.
  void addRow(std::vector<TextCell> row) { rows_.push_back(std::move(row)); }
  [[nodiscard]] bool empty() const noexcept { return rows_.empty(); }

  /// The titles and the rows, each with its end of line; empty without rows.
  [[nodiscard]] std::string text(const TerminalStyle& style) const;

 private:
  [[nodiscard]] std::vector<std::size_t> columnsInUse() const;
  [[nodiscard]] std::size_t widthOf(std::size_t column) const;

  const std::vector<std::string> titles_;
  std::vector<std::vector<TextCell>> rows_;
};

}  // namespace nidus
