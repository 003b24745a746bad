#ifndef REVIEWEDTEXT_H
#define REVIEWEDTEXT_H

#include <gtest/gtest.h>

#include <cstddef>
#include <cstdlib>
#include <fstream>
#include <sstream>
#include <string>

// Compares a text with tests/data/NAME, which somebody has reviewed. With KEL_REVIEW set in the
// environment the file is written first: read the difference before it is committed.
inline void ExpectReviewed(const std::string& name, const std::string& text) {
  const std::string file = std::string(KEL_TEST_DATA "/") + name;
  if (std::getenv("KEL_REVIEW")) std::ofstream(file, std::ios::binary) << text;
  std::ifstream reviewed(file, std::ios::binary);
  std::istringstream lines(text);
  std::string line;
  std::string expected;
  for (int number = 1; std::getline(lines, line); ++number) {
    ASSERT_TRUE(std::getline(reviewed, expected)) << file << " ends before: " << line;
    ASSERT_EQ(line, expected) << file << ":" << number << "; KEL_REVIEW=1 writes it anew";
  }
  EXPECT_FALSE(std::getline(reviewed, expected)) << "not there any more: " << expected;
}

// The text with every `what` replaced, such as a path that differs from run to run.
inline std::string Replaced(std::string text, const std::string& what, const std::string& by) {
  for (std::size_t at = 0; (at = text.find(what, at)) != std::string::npos; at += by.size()) {
    text.replace(at, what.size(), by);
  }
  return text;
}

#endif
