#ifndef KEL_FUZZ_LAW_H
#define KEL_FUZZ_LAW_H

#include <cstdio>
#include <cstdlib>
#include <string_view>

// What must hold for any input. A breach ends the program, so that the input is kept as a finding.
inline void Law(bool holds, const char* words) {
  if (holds) return;
  std::fprintf(stderr, "The law does not hold that %s\n", words);
  std::abort();
}

// Whether each listed source of an input finds its library. Not if an entry has slashes that paths
// don't keep, or names a directory as a language's is named.
inline bool TellsLibraries(std::string_view input) {
  for (std::size_t at = 0; (at = input.find('/', at)) != input.npos; ++at) {
    const auto isOdd = [](char c) {
      return std::string_view(" \t\r\n\"'()[]/#\xFF").find(c) != std::string_view::npos;
    };
    if (at == 0 || isOdd(input[at - 1]) || at + 1 == input.size() || isOdd(input[at + 1]))
      return false;
  }
  return input.find("vhdl/") == input.npos && input.find("verilog/") == input.npos;
}

#endif
