// One expression tells a key from a bare name. What it finds is cut up by place, since each part
// but the first has a fixed length.

#include "Tarvo_Kel_Key.h"

#include <algorithm>
#include <string_view>
#include <tuple>
#include <utility>

#include "Port_Regexp.h"

namespace Tarvo {

namespace {

const char* const kVersionSuffix = "[_][vV][0-9]+[_][0-9][0-9][_][a-zA-Z]$";

// The range of the version suffix. A text that goes on behind a NUL byte, where the expression sees
// its end, has none.
Port_Range FindSuffix(const StringBase& text) {
  // Never destroyed, since keys may be made while the program ends.
  static const auto& expression = *new Port_Regexp(kVersionSuffix);
  const Port_Range match = expression.GetRangeOfMatch(text, 0);
  return match.IsEmpty() || match.last + 1 == text.GetLength() ? match : Port_Range();
}

// The version of a suffix "vMAJOR_MINOR_LETTER": "MAJOR.MINOR.LETTER", MAJOR without leading zeros.
StringBase WriteVersion(std::string_view suffix) {
  const std::size_t major = std::min(suffix.find_first_not_of('0', 1), suffix.find('_') - 1);
  StringBase version(suffix.substr(major));
  version.ReplaceChars('_', '.');
  return version;
}

}  // namespace

Kel_Key::Kel_Key() = default;

Kel_Key::Kel_Key(const StringBase& text) { valid = ExtractVersion(text); }

Kel_Key::Kel_Key(const Kel_Key&) = default;

Kel_Key::Kel_Key(Kel_Key&&) noexcept = default;

// Memory may run out while the copy is made, but not afterwards.
Kel_Key& Kel_Key::operator=(const Kel_Key& other) {
  Kel_Key copy(other);
  return *this = std::move(copy);
}

Kel_Key& Kel_Key::operator=(Kel_Key&&) noexcept = default;

Kel_Key::~Kel_Key() = default;

// The new key is built apart, since the text may be a part of this one and memory may run out.
bool Kel_Key::ExtractVersion(const StringBase& text) {
  const Port_Range suffix = FindSuffix(text);
  // A text that is nothing but a version leaves a valid key as it is.
  const bool onlySuffix = !suffix.IsEmpty() && suffix.first == 0;
  if (onlySuffix && valid) return true;
  Kel_Key read;
  read.valid = !suffix.IsEmpty() && !onlySuffix && read.ReadSuffix(text, suffix);
  if (!read.valid) read.BecomeBareName(text);
  *this = std::move(read);
  return valid;
}

// From the suffix's first character: "_", "v", the major digits, "_", two minor digits, "_",
// letter. False for a number that does not fit.
bool Kel_Key::ReadSuffix(const StringBase& text, const Port_Range& suffix) {
  if (!text.GetUINT32({suffix.first + 2, suffix.last - 5}, &major) ||
      !text.GetUINT32({suffix.last - 3, suffix.last - 2}, &minor)) {
    return false;
  }
  name = text.Extract({0, suffix.first - 1});
  // A key is written with a small version whatever its text was, so that one version has one key.
  StringBase lowered = text.Extract({suffix.first + 1, suffix.last});
  lowered.MakeLower();
  key = name;
  key.Append("_");
  key.Append(lowered);
  revision = lowered.Extract({lowered.GetLength() - 1, lowered.GetLength() - 1});
  version = WriteVersion(lowered.View());
  return true;
}

void Kel_Key::BecomeBareName(const StringBase& text) {
  key = text;
  name = text;
  version.Empty();
  major = 0;
  minor = 0;
  revision.Empty();
}

bool Kel_Key::IsValid() const { return valid; }

const StringBase& Kel_Key::GetKey() const { return key; }

const StringBase& Kel_Key::GetName() const { return name; }

const StringBase& Kel_Key::GetVersion() const { return version; }

const StringBase& Kel_Key::GetRevision() const { return revision; }

unsigned int Kel_Key::GetMajorVersion() const { return major; }

unsigned int Kel_Key::GetMinorVersion() const { return minor; }

bool Kel_Key::operator==(const Kel_Key& other) const { return key == other.key; }

bool Kel_Key::operator!=(const Kel_Key& other) const { return key != other.key; }

bool Kel_Key::operator<(const Kel_Key& other) const {
  if (version.GetLength() == 0) return false;
  if (other.version.GetLength() == 0) return true;
  return std::tie(major, minor, revision) < std::tie(other.major, other.minor, other.revision);
}

bool Kel_Key::operator>(const Kel_Key& other) const { return other < *this; }

}  // namespace Tarvo
