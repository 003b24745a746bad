#include "Json.h"

#include <iostream>

void WriteJson(const Json& members) {
  constexpr int formatVersion = 1;
  constexpr int indent = 2;
  Json document = {{"format_version", formatVersion}};
  document.update(members);
  std::cout << document.dump(indent, ' ', false, Json::error_handler_t::replace) << '\n';
}
