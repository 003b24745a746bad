#include "Port_Regexp.h"

#include <cstring>
#include <mutex>
#include <new>
#include <stdexcept>
#include <string>

#define PCRE2_CODE_UNIT_WIDTH 8
#include <pcre2.h>

namespace {

struct Free {
  void operator()(pcre2_code* code) const noexcept { pcre2_code_free(code); }
  void operator()(pcre2_match_data* data) const noexcept { pcre2_match_data_free(data); }
};

// With DOLLAR_ENDONLY "$" is the very end, and not the place before a last line end too.
std::unique_ptr<pcre2_code, Free> CompileCode(const std::string& pattern) {
  int error = 0;
  PCRE2_SIZE position = 0;
  std::unique_ptr<pcre2_code, Free> code(pcre2_compile(reinterpret_cast<PCRE2_SPTR>(pattern.data()),
                                                       pattern.size(), PCRE2_DOLLAR_ENDONLY, &error,
                                                       &position, nullptr));
  if (code) return code;
  if (error == PCRE2_ERROR_HEAP_FAILED) throw std::bad_alloc();
  throw std::invalid_argument("Invalid regular expression " + pattern);
}

}  // namespace

struct Port_Regexp::Program {
  explicit Program(const char* text) : pattern(text), code(CompileCode(pattern)) {}

  std::string pattern;
  std::unique_ptr<pcre2_code, Free> code;
};

// Keeps the last program only: the library has one pattern, and what callers use cannot pile up.
// What is kept is never destroyed, since keys may be made while the program ends.
std::shared_ptr<const Port_Regexp::Program> Port_Regexp::Compile(const char* pattern) {
  static auto& mutex = *new std::mutex;
  static auto& last = *new std::shared_ptr<const Program>;
  const std::lock_guard<std::mutex> lock(mutex);
  if (!last || last->pattern != pattern) last = std::make_shared<const Program>(pattern);
  return last;
}

Port_Regexp::Port_Regexp(const char* pattern) : program(Compile(pattern)) {}

Port_Regexp::Port_Regexp(const Port_Regexp&) = default;

Port_Regexp& Port_Regexp::operator=(const Port_Regexp&) = default;

Port_Regexp::~Port_Regexp() = default;

Port_Range Port_Regexp::GetRangeOfMatch(const char* text, unsigned start) const {
  const std::size_t length = std::strlen(text);
  // Behind the end there is nothing to match, not even an empty text.
  if (start > length) return {};
  const std::unique_ptr<pcre2_match_data, Free> data(pcre2_match_data_create(1, nullptr));
  if (!data) throw std::bad_alloc();
  const int result = pcre2_match(program->code.get(), reinterpret_cast<PCRE2_SPTR>(text), length,
                                 start, 0, data.get(), nullptr);
  if (result == PCRE2_ERROR_NOMATCH) return {};
  if (result == PCRE2_ERROR_NOMEMORY) throw std::bad_alloc();
  // One of the engine's limits: a text that would take too long is an error and no wait.
  if (result < 0) throw std::runtime_error("Unable to match " + program->pattern);

  const PCRE2_SIZE* const match = pcre2_get_ovector_pointer(data.get());
  const auto first = static_cast<unsigned>(match[0]);
  return match[1] > match[0] ? Port_Range(first, static_cast<unsigned>(match[1] - 1))
                             : Port_Range();
}
