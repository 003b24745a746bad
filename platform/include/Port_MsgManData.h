#ifndef PORT_MSGMANDATA_H
#define PORT_MSGMANDATA_H

#include <cstdarg>
#include <functional>

#include "Port_Export.h"

// One message on its way to the user. All pointers are good during the handler's call only.
struct Port_Message {
  enum Severity { Warning, Error, Fatal };

  Severity severity;
  const char* domain;    // the part of the program that speaks
  const char* file;      // path stem of the source file that issued it
  int line;              // line of the issuing statement in that file
  const char* revision;  // revision of that file
  const char* text;      // one line or several; each ends, and behind the last may be an empty one

  // The file that was being read, and its line (see Port_Input). Empty and 0 if none was; the line
  // alone is 0 if the file was not read line by line.
  const char* inputFile;
  unsigned inputLine;
};

// The message manager: one statement makes a message and issues it.
//
//     Port_MsgManData::createObject("tarvomsg", "s/Tarvo_X", __LINE__, "1.0").issueError("...\n");
//
// A message goes to the handler that stands at the time, by default one that writes it to standard
// error. Issuing never throws, also when memory is short: then the end of a long text is left out.
// A message whose handler throws goes to standard error instead.
//
// Threads: messages may be issued and handlers exchanged from several threads. Calls of the handler
// and of the loggers' sinks from several threads never overlap, and once setHandler has returned in
// one thread, the handler that stood before is no longer running in another. A handler may itself
// issue messages, write traces and set handlers, but must not wait for another thread that does.
class PORT_EXPORT Port_MsgManData {
 public:
  using Handler = std::function<void(const Port_Message&)>;

  // The object belongs to the calling thread and is good for the one issue call that follows at
  // once. The texts are not copied; literals are meant.
  static Port_MsgManData& createObject(const char* domain, const char* file, int line,
                                       const char* revision) noexcept;

  void issueWarning(const char* format, ...) noexcept PORT_PRINTF(2, 3);
  void issueError(const char* format, ...) noexcept PORT_PRINTF(2, 3);
  // Returns as the others do: it is for the handler to end the program. The code is not used.
  void issueFatal(int code, const char* format, ...) noexcept PORT_PRINTF(3, 4);

  // Sets the handler and gives the one that stood before; empty means the default in both places.
  // May throw std::bad_alloc; then the handler that stood before still stands.
  static Handler setHandler(Handler handler);

 private:
  Port_MsgManData() noexcept = default;
  PORT_LOCAL void Issue(Port_Message::Severity severity, const char* format,
                        std::va_list arguments) noexcept PORT_PRINTF(3, 0);

  Port_Message message{};
};

#endif
