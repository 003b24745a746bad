#ifndef TARVO_KELDIAGNOSTIC_H
#define TARVO_KELDIAGNOSTIC_H

#include <memory>
#include <vector>

#include "Tarvo_Export.h"

namespace Tarvo {

class DiagnosticCollector;

// A place in a file. Lines and columns are counted from 1, columns and lengths in bytes of the line
// as it stands in the file, behind a byte order mark. A 0 means that there is none: a place without
// a line is the file or directory as a whole, one without a column the whole line. Without a file
// it is no place at all.
struct KelPlace {
  StringBase file;
  unsigned line = 0;
  unsigned column = 0;
  unsigned length = 0;
};

// A further place that belongs to a diagnostic, and what is there, such as "first declared here".
struct KelRelatedPlace {
  KelPlace place;
  StringBase text;
};

// Something that is wrong with a core or a repository, or that is probably a mistake.
struct KelDiagnostic {
  enum Severity { Note, Warning, Error };

  Severity severity = Error;
  StringBase code;  // such as "unknown-library"; stays the same from version to version
  StringBase text;  // one line but for the code "failed"; no full stop; any bytes of a file
  StringBase hint;  // what to do about it, or empty
  KelPlace place;
  std::vector<KelRelatedPlace> related;
};

// What there is to know about a code. The texts are constant and last as long as the program.
struct KelDiagnosticCode {
  const char* code;
  KelDiagnostic::Severity severity;
  const char* title;  // a few words
  const char* help;   // what it means and what to do, in sentences
};

// Keeps, while it lives, what the operations of its thread find wrong with what they read: each
// fault once, where it is, however many messages of callers follow from it. A fault in a core that
// others include has the lines that take it in among its related places, the nearest first.
//
//     const Tarvo::KelDiagnosticLog log;
//     if (!ip->ListSynthesisSources(sources))
//       for (const auto& fault : log.Take())
//         std::cerr << fault.place.file << ": " << fault.text << '\n';
//
// Messages are issued as ever. What fails without reading a file, such as a question for an unknown
// key, is kept too, with the code "failed", the lines of its message as text, and no place.
//
// What memory has no room for is left out. Threads: a log belongs to the thread that made it. Logs
// nest, and end in reverse order; the innermost one keeps.
class TARVO_EXPORT KelDiagnosticLog {
 public:
  KelDiagnosticLog();
  ~KelDiagnosticLog();
  KelDiagnosticLog(const KelDiagnosticLog&) = delete;
  KelDiagnosticLog& operator=(const KelDiagnosticLog&) = delete;

  // What came since the last call, in the order in which it was found.
  std::vector<KelDiagnostic> Take() const;

 private:
  std::unique_ptr<DiagnosticCollector> collector;
};

}  // namespace Tarvo

#endif
