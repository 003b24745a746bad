// Preloaded, lets chosen calls to the system fail: those that concern a path below the directory
// FAILING_BELOW, or a descriptor that was opened there, are counted from 1, and each whose number
// stands in FAILING_CALLS fails with the error number FAILING_ERROR. All that were counted are
// written to the file FAILING_LOG, one on a line. Each that gives a path takes FAILING_DELAY
// microseconds longer, as on a disk that is far away.

#undef _FORTIFY_SOURCE  // which makes some of these functions inline ones

#include <dirent.h>
#include <dlfcn.h>
#include <fcntl.h>
#include <sys/stat.h>
#include <sys/syscall.h>
#include <unistd.h>

#include <array>
#include <atomic>
#include <cerrno>
#include <cstdarg>
#include <cstdio>
#include <cstdlib>
#include <ctime>
#include <string>
#include <string_view>

namespace {

const char* Setting(const char* name) {
  const char* const value = std::getenv(name);
  return value == nullptr ? "" : value;
}

// What the system itself gives as the path of a descriptor, or an empty text.
std::string PathOf(int descriptor) {
  const std::string link = "/proc/self/fd/" + std::to_string(descriptor);
  std::array<char, 4096> path{};
  const long size = ::syscall(SYS_readlinkat, AT_FDCWD, link.c_str(), path.data(), path.size());
  return {path.data(), size > 0 ? static_cast<std::size_t>(size) : 0};
}

std::string PathOf(const char* path) { return path == nullptr ? "" : path; }

std::string PathOf(DIR* directory) { return PathOf(::dirfd(directory)); }

std::string PathOf(int directory, const char* path) {
  const std::string name = PathOf(path);
  return directory == AT_FDCWD || name[0] == '/' ? name : PathOf(directory) + '/' + name;
}

void Log(const std::string& line) {
  const char* const file = Setting("FAILING_LOG");
  if (*file == 0) return;
  const long log =
      ::syscall(SYS_openat, AT_FDCWD, file, O_WRONLY | O_APPEND | O_CREAT | O_CLOEXEC, 0600);
  if (log < 0) return;
  ::syscall(SYS_write, log, line.data(), line.size());
  ::syscall(SYS_close, log);
}

bool IsChosen(unsigned long number) {
  const char* rest = Setting("FAILING_CALLS");
  for (char* end = nullptr;; rest = end) {
    const unsigned long chosen = std::strtoul(rest, &end, 10);
    if (end == rest || chosen == number) return end != rest;
  }
}

// Those that are given a descriptor need not look for anything.
bool IsLook(std::string_view call) {
  return call != "read" && call != "fstat" && call != "fstat64" && call != "fdopendir" &&
         call != "readdir" && call != "readdir64";
}

void Delay() {
  static const long delay = std::atol(Setting("FAILING_DELAY"));
  if (delay == 0) return;
  const timespec time = {0, delay * 1000};
  ::nanosleep(&time, nullptr);
}

// Counts a call. True, with the error number set, if it is to fail.
bool Fails(const char* call, const std::string& path) {
  static std::atomic<unsigned long> count = 0;
  const int kept = errno;
  const std::string below = std::string(Setting("FAILING_BELOW")) + '/';
  const bool counts = (path + '/').compare(0, below.size(), below) == 0;
  if (counts) Log(std::string(call) + ' ' + path + '\n');
  if (counts && IsLook(call)) Delay();
  const bool fails = counts && IsChosen(++count);
  errno = fails ? std::atoi(Setting("FAILING_ERROR")) : kept;
  return fails;
}

mode_t ModeOf(int flags, va_list list) { return (flags & O_CREAT) != 0 ? va_arg(list, mode_t) : 0; }

}  // namespace

#define EXPORTED extern "C" __attribute__((visibility("default")))

// Fails with a result, or does what the next library's function does.
#define CALL(name, path, failure, ...)                                                     \
  static const auto next = reinterpret_cast<decltype(&::name)>(::dlsym(RTLD_NEXT, #name)); \
  return Fails(#name, PathOf path) ? (failure) : next(__VA_ARGS__)

#define OPEN(name, path, ...)              \
  va_list list;                            \
  va_start(list, flags);                   \
  const mode_t mode = ModeOf(flags, list); \
  va_end(list);                            \
  CALL(name, path, -1, __VA_ARGS__, flags, mode)

using Text = const char*;
using Status = struct stat;
using Status64 = struct stat64;
using StatusX = struct statx;

EXPORTED int open(Text p, int flags, ...) { OPEN(open, (p), p); }
EXPORTED int open64(Text p, int flags, ...) { OPEN(open64, (p), p); }
EXPORTED int openat(int d, Text p, int flags, ...) { OPEN(openat, (d, p), d, p); }
EXPORTED int openat64(int d, Text p, int flags, ...) { OPEN(openat64, (d, p), d, p); }
EXPORTED FILE* fopen(Text p, Text m) { CALL(fopen, (p), nullptr, p, m); }
EXPORTED FILE* fopen64(Text p, Text m) { CALL(fopen64, (p), nullptr, p, m); }
EXPORTED ssize_t read(int d, void* b, size_t n) { CALL(read, (d), -1, d, b, n); }
EXPORTED int stat(Text p, Status* s) noexcept { CALL(stat, (p), -1, p, s); }
EXPORTED int stat64(Text p, Status64* s) noexcept { CALL(stat64, (p), -1, p, s); }
EXPORTED int lstat(Text p, Status* s) noexcept { CALL(lstat, (p), -1, p, s); }
EXPORTED int lstat64(Text p, Status64* s) noexcept { CALL(lstat64, (p), -1, p, s); }
EXPORTED int fstat(int d, Status* s) noexcept { CALL(fstat, (d), -1, d, s); }
EXPORTED int fstat64(int d, Status64* s) noexcept { CALL(fstat64, (d), -1, d, s); }
EXPORTED int fstatat(int d, Text p, Status* s, int f) noexcept {
  CALL(fstatat, (d, p), -1, d, p, s, f);
}
EXPORTED int fstatat64(int d, Text p, Status64* s, int f) noexcept {
  CALL(fstatat64, (d, p), -1, d, p, s, f);
}
EXPORTED int statx(int d, Text p, int f, unsigned m, StatusX* s) noexcept {
  CALL(statx, (d, p), -1, d, p, f, m, s);
}
EXPORTED int access(Text p, int m) noexcept { CALL(access, (p), -1, p, m); }
EXPORTED int faccessat(int d, Text p, int m, int f) noexcept {
  CALL(faccessat, (d, p), -1, d, p, m, f);
}
EXPORTED ssize_t readlink(Text p, char* b, size_t n) noexcept { CALL(readlink, (p), -1, p, b, n); }
EXPORTED char* realpath(Text p, char* b) noexcept { CALL(realpath, (p), nullptr, p, b); }
EXPORTED DIR* opendir(Text p) { CALL(opendir, (p), nullptr, p); }
EXPORTED DIR* fdopendir(int d) { CALL(fdopendir, (d), nullptr, d); }
EXPORTED dirent* readdir(DIR* d) { CALL(readdir, (d), nullptr, d); }
EXPORTED dirent64* readdir64(DIR* d) { CALL(readdir64, (d), nullptr, d); }
