// Diagnostics of names that are not there, with those that may be meant.

#include "Tarvo_TellUnknown.h"

#include <algorithm>
#include <string>

#include "Tarvo_KelLibrary_Utils.h"
#include "Tarvo_Kel_Index.h"
#include "Tarvo_Kel_Key.h"
#include "Tarvo_TellFault.h"
#include "Tarvo_Word.h"

namespace Tarvo {

namespace {

StringBase Sentence(const char* start, const StringList& words, const char* end) {
  std::string text = start;
  for (const StringBase& word : words) {
    text += &word == &words.front() ? "" : ", ";
    text += word.View();
  }
  return StringBase(std::string_view(text + end));
}

StringBase NearCores(const Kel_Index& index, const Kel_Key& asked) {
  if (!Diagnosis::MayHint()) return {};
  StringList versions;
  StringList names;
  for (const StringBase& version : index.GetAllVersionKeys()) {
    const Kel_Key key(version);
    if (key.GetName() == asked.GetName()) versions.push_back(version);
    if (names.empty() || names.back() != key.GetName()) names.push_back(key.GetName());
  }
  if (!versions.empty()) return Sentence("the versions of this core are ", versions, "");
  return DidYouMean(asked.GetName().View(), names);
}

}  // namespace

StringBase DidYouMean(std::string_view text, const StringList& words) {
  if (!Diagnosis::MayHint()) return {};
  const StringList near = KelLibrary_Utils::ListNear(StringBase(text), words);
  return near.empty() ? StringBase() : Sentence("did you mean ", near, "?");
}

StringBase FindMisspelt(std::string_view text, const StringList& words) {
  const StringBase asked(text);
  if (std::find(words.begin(), words.end(), asked) != words.end()) return {};
  const StringList near = KelLibrary_Utils::ListNear(asked, words);
  // Stricter than for a hint: a property that somebody made up must not pass for a misspelt one.
  const auto fits = [&](const StringBase& word) {
    const bool isAsLong =
        word.GetLength() + 1 >= text.size() && text.size() + 1 >= word.GetLength();
    return EqualsIgnoringCase(asked, word) || (text.size() >= 3 && isAsLong);
  };
  const auto found = std::find_if(near.begin(), near.end(), fits);
  return found == near.end() ? StringBase() : *found;
}

KelDiagnostic TellUnknownLibrary(const FileScanner& lines, const Kel_Index& index,
                                 std::string_view library) {
  return Diagnosis::At(Codes::kUnknownLibrary, SpanOf(lines, library),
                       Diagnosis::Say({"there is no core '", library, "'"}),
                       NearCores(index, Kel_Key(StringBase(library))));
}

KelDiagnostic TellUnknownParameter(const FileScanner& lines, std::string_view name,
                                   const StringList& parameters) {
  return Diagnosis::At(Codes::kUnknownParameter, SpanOf(lines, name),
                       Diagnosis::Say({"the core has no parameter '", name, "'"}),
                       DidYouMean(name, parameters));
}

KelDiagnostic TellNoRepository(const StringBase& directory) {
  return Diagnosis::Of(Codes::kNotARepository, directory,
                       Diagnosis::Say({"this is no repository, it has no subdirectory ",
                                       Kel_Index::KEL_VERSIONS_SUBDIRECTORY.View()}));
}

}  // namespace Tarvo
