#include "Table.h"

#include <unistd.h>

#include <algorithm>
#include <cstddef>
#include <iostream>

namespace {

// The last field of a row needs no padding; a width of 0 asks for a tab instead.
void WriteRow(const Table::Row& row, const std::vector<std::size_t>& widths) {
  for (std::size_t i = 0; i + 1 < row.size(); ++i) {
    const std::string gap = widths[i] ? std::string(widths[i] + 2 - row[i].size(), ' ') : "\t";
    std::cout << row[i] << gap;
  }
  std::cout << row.back() << '\n';
}

}  // namespace

std::vector<std::size_t> Table::Widths() const {
  std::vector<std::size_t> widths;
  for (const Row& row : rows) {
    widths.resize(std::max(widths.size(), row.size()));
    for (std::size_t i = 0; i < row.size(); ++i) widths[i] = std::max(widths[i], row[i].size());
  }
  if (!::isatty(STDOUT_FILENO)) std::fill(widths.begin(), widths.end(), 0);
  return widths;
}

void Table::Write() const {
  const std::vector<std::size_t> widths = Widths();
  for (const Row& row : rows) WriteRow(row, widths);
}
