#ifndef KEL_BENCH_SCRATCH_H
#define KEL_BENCH_SCRATCH_H

#include <filesystem>
#include <functional>
#include <string>

namespace Scratch {

// The path of what is measured, a file or directory of that name, which `make` makes unless it is
// there already. It lies in the directory that KEL_BENCH_DIRECTORY names, which keeps it for the
// next program, or in one that goes when the program ends.
std::filesystem::path Prepare(const std::string& name,
                              const std::function<void(const std::filesystem::path&)>& make);

// Writes a file of the repository's version `core`_v1_00_a, into its directory `data`.
void WriteDataFile(const std::filesystem::path& repository, const std::string& core,
                   const std::string& extension, const std::string& text);

// A core description of about 140 lines and 10 KB: six options, some parameters, many ports.
std::string Description();

}  // namespace Scratch

#endif
