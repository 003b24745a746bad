#include "Json.h"

#include "Text.h"

Json Texts(const Tarvo::StringList& list) {
  Json texts = Json::array();
  for (const Tarvo::StringBase& text : list) texts.push_back(Text(text));
  return texts;
}

void WriteDocument(std::ostream& output, const Json& document) {
  constexpr int indent = 2;
  output << document.dump(indent, ' ', false, Json::error_handler_t::replace) << '\n';
}

void WriteJson(const Json& members, std::ostream& output) {
  constexpr int formatVersion = 1;
  Json document = {{"format_version", formatVersion}};
  document.update(members);
  WriteDocument(output, document);
}
