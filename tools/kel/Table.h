#ifndef KEL_TABLE_H
#define KEL_TABLE_H

#include <cstddef>
#include <iostream>
#include <string>
#include <vector>

// Rows of fields: aligned in columns if standard output is a terminal, with a tab between the
// fields into a pipe or file, where scripts read them. Control characters are written as \xNN, so
// that a row stays one line and no field breaks into two.
class Table {
 public:
  using Row = std::vector<std::string>;

  void Add(const Row& fields);
  bool IsEmpty() const { return rows.empty(); }
  void Write(std::ostream& output = std::cout) const;

 private:
  std::vector<std::size_t> Widths() const;

  std::vector<Row> rows;
};

#endif
