#ifndef OUTCOME_H
#define OUTCOME_H

#include <string>
#include <type_traits>

#include "Tarvo_AppException.h"

// What an operation gives as a text, empty if it gives none, or what it throws: "not found: ...",
// "failure: ..." or "fatal: ...".
template <class Operation>
std::string Outcome(const Operation& operation) {
  const char* const levels[] = {"not found: ", "failure: ", "fatal: "};
  try {
    if constexpr (std::is_constructible_v<std::string, decltype(operation())>) {
      return std::string(operation());
    } else {
      operation();
      return "";
    }
  } catch (const Tarvo::AppException& exception) {
    return std::string(levels[exception.level]) + exception.what();
  }
}

#endif
