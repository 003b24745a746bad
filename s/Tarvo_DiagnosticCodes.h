#ifndef TARVO_DIAGNOSTICCODES_H
#define TARVO_DIAGNOSTICCODES_H

#include "Tarvo_KelDiagnostic.h"

// The catalogue of what a diagnostic may be, a row for each code. docs/diagnostics.md has an
// example of each, which a test runs.
namespace Tarvo::Codes {

using Code = KelDiagnosticCode;
constexpr auto kNote = KelDiagnostic::Note;
constexpr auto kWarning = KelDiagnostic::Warning;
constexpr auto kError = KelDiagnostic::Error;

inline constexpr Code kBadEntry{
    "bad-entry", kError, "entry of an analyse order can't be read",
    "An entry is 'lib LIBRARY FILE [LANGUAGE]', with synlib or simlib in place of lib for one "
    "purpose alone, 'lib LIBRARY all', or 'vlgincdir LIBRARY DIRECTORY'."};
inline constexpr Code kBadHeader{
    "bad-header", kError, "netlist table has no header that can be read",
    "The first line of a table names parameters of the core and ends in the word FILES."};
inline constexpr Code kBadRange{
    "bad-range", kWarning, "range that can't be read",
    "A VEC is [LEFT:RIGHT]; a RANGE is (LOW:HIGH), or values with commas between. Each side is an "
    "expression of numbers and parameters."};
inline constexpr Code kBadRow{
    "bad-row", kError, "row of a netlist table can't be read",
    "A row has a value for each parameter of the header, and then one or more netlists with commas "
    "between."};
inline constexpr Code kBadStatement{
    "bad-statement", kError, "statement of a description can't be read",
    "A statement is a keyword and 'name = value', with further 'key = value' behind commas. A "
    "value "
    "of several words stands in quotes or brackets. An interface is named by its BUS or IO_IF."};
inline constexpr Code kBadValue{
    "bad-value", kWarning, "value that an option or a property does not take",
    "The option STYLE is HDL, BLACKBOX or MIX, and HDL is VHDL, Verilog, MIXED or BOTH. "
    "VHDL_STANDARD is 93, 02, 08 or 19, TOP is one name, and HDL_LIBRARY a name of a VHDL library. "
    "DIR is I, O or IO, ENDIAN is BIG or LITTLE, and TYPE of a parameter is HDL or NON_HDL."};
inline constexpr Code kCommentInValue{
    "comment-in-value", kWarning, "comment that is probably part of a value",
    "A '#' begins a comment wherever it stands, in quotes and brackets too, so no value can have "
    "one. "
    "Write a number in decimal, and put a blank in front of a comment."};
inline constexpr Code kDuplicateIncludeDirectory{
    "duplicate-include-directory", kError, "second include directory of one library",
    "A library has one Verilog include directory in an analyse order."};
inline constexpr Code kDuplicateName{
    "duplicate-name", kWarning, "second declaration of a name",
    "When a name is declared twice, the first declaration counts and the others are ignored."};
inline constexpr Code kDuplicateRow{
    "duplicate-row", kWarning, "row that repeats an earlier one",
    "The same netlist is listed at the same values already, so it would be handed on twice."};
inline constexpr Code kDuplicateSource{
    "duplicate-source", kWarning, "source that is listed already",
    "A source stands in an analyse order once; its first place counts."};
inline constexpr Code kEmptyOrder{
    "empty-order", kWarning, "analyse order without a source",
    "The core should have sources, but its order lists none, so there is nothing to analyse."};
inline constexpr Code kFailed{"failed", kError, "request failed",
                              "The text says what was asked for, and why there is no answer."};
inline constexpr Code kIgnoredEntry{
    "ignored-entry", kWarning, "entry that is ignored as a whole",
    "Write vlgincdir in small letters, and nothing after the directory."};
inline constexpr Code kIgnoredPurpose{
    "ignored-purpose", kWarning, "purpose that a whole library does not heed",
    "With 'all', synlib and simlib do what lib does: the library is taken for synthesis and for "
    "simulation. Write 'lib LIBRARY all', or list the sources for one purpose one by one."};
inline constexpr Code kIncludeCircle{
    "include-circle", kError, "cores that include each other in a circle",
    "A core can't be analysed before itself. Take one of the includes out."};
inline constexpr Code kIncludeTooDeep{"include-too-deep", kError, "includes that nest too deep",
                                      "Cores may include each other at most 1,000 levels deep."};
inline constexpr Code kLanguageMismatch{"language-mismatch", kError, "file of the other language",
                                        "The extension v is for Verilog and vhd for VHDL. Name the "
                                        "file's language behind it, or set the "
                                        "option HDL of the core."};
inline constexpr Code kLanguageNotAllowed{
    "language-not-allowed", kError, "language in an order that goes by extensions",
    "A core whose option HDL is BOTH goes by file extensions only. Remove the language; until then "
    "the source is left out."};
inline constexpr Code kListEnds{
    "list-ends", kWarning, "list that ends before the line does",
    "A list ends at the first word without a comma before it, and the rest of the line is ignored. "
    "A value of several words needs quotes or brackets."};
inline constexpr Code kMissingDataFile{
    "missing-data-file", kError, "data file does not exist",
    "The option DATA_FILES names files below the directory of the core, with commas between."};
inline constexpr Code kMissingDescription{
    "missing-description", kError, "core without a description",
    "A version is listed only if data/NAME_v2_1_0.qvr is there; NAME is the core's base name."};
inline constexpr Code kMissingIncludeDirectory{
    "missing-include-directory", kError, "include directory does not exist",
    "The directory is looked for below the core whose analyse order is read."};
inline constexpr Code kMissingNetlist{"missing-netlist", kError, "netlist does not exist",
                                      "Netlists lie in the directory netlist of their core."};
inline constexpr Code kMissingOrder{
    "missing-order", kError, "core without an analyse order",
    "A core needs data/NAME_v2_1_0.ldx if its option STYLE is HDL or MIX, or if another core "
    "includes it."};
inline constexpr Code kMissingSource{
    "missing-source", kError, "source does not exist",
    "Sources lie below hdl/vhdl and hdl/verilog of their library."};
inline constexpr Code kMissingTable{
    "missing-table", kError, "core without a netlist table",
    "A core whose option STYLE is BLACKBOX or MIX needs data/NAME_v2_1_0.tew."};
inline constexpr Code kNoLanguage{"no-language", kError, "source without a language",
                                  "A name without the extension v or vhd needs a language behind "
                                  "it, or one from the option HDL."};
inline constexpr Code kNotAKey{
    "not-a-key", kWarning, "directory that looks like a core except for its name",
    "A version directory bears the version's key, such as abc_v1_00_a. Any other is passed over."};
inline constexpr Code kNotARepository{
    "not-a-repository", kWarning, "repository without ipmods",
    "A repository is a directory with a subdirectory ipmods, which holds the versions."};
inline constexpr Code kRowNeverApplies{
    "row-never-applies", kWarning, "row that can never apply",
    "A row applies when each parameter has exactly the value of the row. Values are separated by "
    "blanks, not commas, and should be among those that the parameter takes."};
inline constexpr Code kTrailingComma{"trailing-comma", kWarning, "statement that ends in a comma",
                                     "No statement goes on in the next line."};
inline constexpr Code kUndeclaredInterface{
    "undeclared-interface", kWarning, "port or parameter of an undeclared interface",
    "BUS names bus interfaces and IO_IF I/O interfaces that the same description declares."};
inline constexpr Code kUnknownKeyword{
    "unknown-keyword", kWarning, "line that is nearly a statement",
    "Statements begin with OPTION, PARAMETER, PORT, BUS_INTERFACE or IO_INTERFACE, in capitals and "
    "with a blank behind. Any other line is ignored."};
inline constexpr Code kUnknownLanguage{
    "unknown-language", kError, "unknown language of a source",
    "A source's language is VHDL or Verilog. The source is left out."};
inline constexpr Code kUnknownLibrary{
    "unknown-library", kError, "core that is not in the library",
    "A library is the key of a version, or the bare name of a core, in one of the repositories."};
inline constexpr Code kUnknownParameter{
    "unknown-parameter", kError, "column for a parameter that the core does not have",
    "The header of a table names parameters of the core's description, in the same letter case."};
inline constexpr Code kUnknownProperty{
    "unknown-property", kWarning, "property that is nearly a known one",
    "Properties are handed on whatever their names, so a misspelt one has no effect."};
inline constexpr Code kUnlistedFile{
    "unlisted-file", kNote, "file that nothing lists",
    "No analyse order lists this source, or no table this netlist."};
inline constexpr Code kUnreadable{
    "unreadable", kError, "file or directory can't be read",
    "Look at its permissions, and whether it is a plain file or directory."};
inline constexpr Code kVersionConflict{
    "version-conflict", kWarning, "two versions of one core in one order",
    "Both versions are analysed, though they mostly declare the same names. Include one of them "
    "everywhere."};

// In the order of the alphabet.
inline constexpr const Code* kAll[] = {&kBadEntry,
                                       &kBadHeader,
                                       &kBadRange,
                                       &kBadRow,
                                       &kBadStatement,
                                       &kBadValue,
                                       &kCommentInValue,
                                       &kDuplicateIncludeDirectory,
                                       &kDuplicateName,
                                       &kDuplicateRow,
                                       &kDuplicateSource,
                                       &kEmptyOrder,
                                       &kFailed,
                                       &kIgnoredEntry,
                                       &kIgnoredPurpose,
                                       &kIncludeCircle,
                                       &kIncludeTooDeep,
                                       &kLanguageMismatch,
                                       &kLanguageNotAllowed,
                                       &kListEnds,
                                       &kMissingDataFile,
                                       &kMissingDescription,
                                       &kMissingIncludeDirectory,
                                       &kMissingNetlist,
                                       &kMissingOrder,
                                       &kMissingSource,
                                       &kMissingTable,
                                       &kNoLanguage,
                                       &kNotAKey,
                                       &kNotARepository,
                                       &kRowNeverApplies,
                                       &kTrailingComma,
                                       &kUndeclaredInterface,
                                       &kUnknownKeyword,
                                       &kUnknownLanguage,
                                       &kUnknownLibrary,
                                       &kUnknownParameter,
                                       &kUnknownProperty,
                                       &kUnlistedFile,
                                       &kUnreadable,
                                       &kVersionConflict};

}  // namespace Tarvo::Codes

#endif
