#ifndef MESSAGERECORDER_H
#define MESSAGERECORDER_H

#include <string>
#include <vector>

#include "Port_MsgManData.h"

// Catches all messages, and the traces too while asked for, from its making to its end. The one
// place that knows how both are caught. Each entry is one text:
//
//     "error s/Tarvo_KelLibrary: Unable to get name for IP x\n..."       a message
//     "trace: Constructing empty KEL Library\n"                          a trace
class MessageRecorder {
 public:
  enum What { Messages, MessagesAndTraces };

  explicit MessageRecorder(What what = Messages);
  ~MessageRecorder();
  MessageRecorder(const MessageRecorder&) = delete;
  MessageRecorder& operator=(const MessageRecorder&) = delete;

  // What came since the last call.
  std::vector<std::string> Take();

  // The lines at which the messages since the making were issued.
  const std::vector<int>& Lines() const { return lines; }

  // What was being read at each of them, as "abc_v2_1_0.ldx:3", or "" for nothing.
  const std::vector<std::string>& Inputs() const { return inputs; }

 private:
  Port_MsgManData::Handler previous;
  std::vector<std::string> entries;
  std::vector<int> lines;
  std::vector<std::string> inputs;
};

#endif
