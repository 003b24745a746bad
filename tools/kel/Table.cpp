#include "Table.h"

#include <unistd.h>

#include <algorithm>
#include <cstddef>
#include <utility>

#include "Cells.h"
#include "Text.h"

void Table::Add(const Row& fields) {
  Row row;
  for (const std::string& field : fields) row.push_back(Printable(field));
  rows.push_back(std::move(row));
}

std::vector<std::size_t> Table::Widths() const {
  std::vector<std::size_t> widths;
  for (const Row& row : rows) {
    widths.resize(std::max(widths.size(), row.size()));
    for (std::size_t i = 0; i < row.size(); ++i) {
      widths[i] = std::max(widths[i], CountCells(row[i]));
    }
  }
  return widths;
}

// The last field of a row needs nothing behind it.
void Table::Write(std::ostream& output) const {
  const bool aligned = ::isatty(STDOUT_FILENO) != 0;
  const std::vector<std::size_t> widths = aligned ? Widths() : std::vector<std::size_t>();
  for (const Row& row : rows) {
    for (std::size_t i = 0; i + 1 < row.size(); ++i) {
      output << row[i] << (aligned ? std::string(widths[i] + 2 - CountCells(row[i]), ' ') : "\t");
    }
    output << row.back() << '\n';
  }
}
