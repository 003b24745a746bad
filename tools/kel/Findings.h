#ifndef KEL_FINDINGS_H
#define KEL_FINDINGS_H

#include <set>
#include <string>
#include <vector>

#include "Port_MsgManData.h"

// What is wrong with a file, at a line of it or, with the line 0, as a whole.
struct Finding {
  std::string file;
  unsigned line;
  std::string severity;
  std::string text;
  // The file that has the fault, if this is only what follows from it elsewhere.
  std::string cause;

  bool operator<(const Finding& other) const;
};

// Makes findings of the messages that the library issues while it reads: each fault once, at the
// line that has it, however many cores run into it and however many messages that takes. While one
// of these lives, it takes the messages, and the traces, which tell what is being read.
class FindingCollector {
 public:
  FindingCollector();
  ~FindingCollector();
  FindingCollector(const FindingCollector&) = delete;
  FindingCollector& operator=(const FindingCollector&) = delete;

  // What the messages to come are about, if they don't say it themselves.
  void Begin(const std::string& file);

  void Add(const Finding& finding) { findings.insert(finding); }

  // All of them by file and line, without those that only follow from others, or that stand there
  // with their line too.
  std::vector<Finding> Take() const;

 private:
  void TakeMessage(const Port_Message& message);
  void TakeTrace(const std::string& text);
  void TakeBadLine(const std::string& file, unsigned line, const std::string& text);
  void TakeWrapped(const std::string& text, const std::string& reason);
  bool IsToldBetter(const Finding& finding) const;

  std::string subject;
  std::vector<std::string> reading;  // the files that are open, the innermost last
  std::vector<Finding> pending;      // reasons whose line is told by the message to come
  std::set<std::string> filesWithoutHeader;
  std::set<Finding> findings;
  Port_MsgManData::Handler previous;
};

#endif
