#ifndef KEL_FORMATWRITERS_H
#define KEL_FORMATWRITERS_H

#include <ostream>

#include "SourceList.h"

// What writes each format. They stand in FileLists.cpp, Documents.cpp and Scripts.cpp.

void WriteList(std::ostream& output, const SourceList& list);
void WriteFileList(std::ostream& output, const SourceList& list);
void WriteVerilator(std::ostream& output, const SourceList& list);
void WriteVhdlLs(std::ostream& output, const SourceList& list);

void WriteJsonList(std::ostream& output, const SourceList& list);
void WriteEdam(std::ostream& output, const SourceList& list);

void WriteGhdl(std::ostream& output, const SourceList& list);
void WriteTcl(std::ostream& output, const SourceList& list);
void WriteMake(std::ostream& output, const SourceList& list);
void WriteCMake(std::ostream& output, const SourceList& list);

// The one standard of VHDL for a tool that takes no more: the newest that a core asks for, with a
// warning if another asks for an older one; empty if none asks.
std::string OneStandard(const SourceList& list, const char* tool);

#endif
