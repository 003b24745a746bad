#ifndef KEL_TABLE_H
#define KEL_TABLE_H

#include <cstddef>
#include <string>
#include <utility>
#include <vector>

// Rows of fields for standard output: aligned in columns on a terminal, with a tab between the
// fields into a pipe or file, where scripts read them.
class Table {
 public:
  using Row = std::vector<std::string>;

  void Add(Row row) { rows.push_back(std::move(row)); }
  bool IsEmpty() const { return rows.empty(); }
  void Write() const;

 private:
  std::vector<std::size_t> Widths() const;

  std::vector<Row> rows;
};

#endif
