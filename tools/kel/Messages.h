#ifndef KEL_MESSAGES_H
#define KEL_MESSAGES_H

#include <string>

#include "Request.h"
#include "Tarvo_KelDiagnostic.h"

// What the command says beside its answer, on standard error. What the library finds wrong in a
// file stands behind its place, and all else behind "kel: " and its severity, with further lines
// indented. Nothing is shown twice.
namespace Messages {

// While one of these lives, each message of the library shows the diagnostics that it comes with.
// One that comes with none only follows from what was shown.
class Session {
 public:
  explicit Session(const Request& request);
  ~Session();
  Session(const Session&) = delete;
  Session& operator=(const Session&) = delete;

 private:
  Tarvo::KelDiagnosticLog log;
};

void Show(const Tarvo::KelDiagnostic& diagnostic);

// The command's own words. An error counts as one of the library does.
void Note(const std::string& text);
void Warn(const std::string& text);
void Error(const std::string& text);

// The number of errors so far, fatal ones included.
int ErrorCount();

}  // namespace Messages

#endif
