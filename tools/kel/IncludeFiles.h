#ifndef KEL_INCLUDEFILES_H
#define KEL_INCLUDEFILES_H

#include <string>
#include <vector>

// The files in and below an include directory, by name: their names relative to it, as a source
// would include them. Each directory is listed once, whatever links lead to it. At most 16 levels
// and 10,000 files; more of either, or a directory that can't be read, is an error, and what was
// found until then is given.
std::vector<std::string> FilesBelow(const std::string& directory);

#endif
