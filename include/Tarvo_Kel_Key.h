#ifndef TARVO_KEL_KEY_H
#define TARVO_KEL_KEY_H

#include "Tarvo_Export.h"

namespace Tarvo {

// Names one version of one IP core, or, when its text carries no version, a core by its bare name.
//
// The text of a version is the core's base name and a suffix:
//
//     base name  "_v"  major      "_"  minor       "_"  revision
//                      1+ digits       2 digits         1 letter
//
// as in `abc_v1_00_a`. Only the suffix at the very end counts: `abc_v1_00_a_v2_00_b` is a version
// of the core `abc_v1_00_a`. The `v` and the revision may be written in either case and are kept in
// lower case; the base name keeps its case, and the digits stay as written.
//
// Any other text, a suffix without a base name and a number above 32 bits among them, gives an
// invalid key. That is no error: an invalid key is a bare name, and an index takes it as the newest
// version of that core.
//
// Operations that take a text or copy a key may throw std::bad_alloc, and what the platform's
// regular expressions throw on huge texts; the key then stays as it was. A key that was moved from
// may only be assigned to or destroyed. References stay good while the key lives and is not
// changed. Threads: like an int; several may read one key, who changes it must be alone.
class TARVO_EXPORT Kel_Key {
 public:
  // The empty, invalid key.
  Kel_Key();
  explicit Kel_Key(const StringBase& text);
  Kel_Key(const Kel_Key&);
  Kel_Key(Kel_Key&&) noexcept;
  Kel_Key& operator=(const Kel_Key&);
  Kel_Key& operator=(Kel_Key&&) noexcept;
  ~Kel_Key();

  // Reads the text into this key and gives its new validity. On a key that is already valid, a
  // suffix without a base name changes nothing and gives true.
  bool ExtractVersion(const StringBase& text);

  bool IsValid() const;

  // On a valid key: the full text in normal form, the base name, the dotted version such as
  // "1.00.a", and the revision letter. On an invalid one: the text as given, twice, and two empty
  // texts.
  const StringBase& GetKey() const;
  const StringBase& GetName() const;
  const StringBase& GetVersion() const;
  const StringBase& GetRevision() const;

  // 0 on an invalid key.
  unsigned int GetMajorVersion() const;
  unsigned int GetMinorVersion() const;

  // Equality of the full text: `abc_v1_00_a` and `abc_v01_00_a` differ.
  bool operator==(const Kel_Key& other) const;
  bool operator!=(const Kel_Key& other) const;

  // Order of the versions alone, whatever the names: by major, minor, revision. A key without a
  // version is above every key with one. Keys of equal versions are neither less nor greater.
  bool operator<(const Kel_Key& other) const;
  bool operator>(const Kel_Key& other) const;

 private:
  TARVO_LOCAL bool ReadSuffix(const StringBase& text, const Port_Range& suffix);
  TARVO_LOCAL void BecomeBareName(const StringBase& text);

  StringBase key;
  bool valid = false;
  StringBase name;
  StringBase version;
  unsigned int major = 0;
  unsigned int minor = 0;
  StringBase revision;
};

}  // namespace Tarvo

#endif
