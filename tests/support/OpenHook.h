#ifndef OPENHOOK_H
#define OPENHOOK_H

#include <functional>

// While one of these lives, each opening of a file in this process goes through a function: it is
// called with the path, in the thread that opens, and gives 0 or the error number to fail with. So
// a disk may be slow, and a file vanish just as it is looked for. One at a time.
class OpenHook {
 public:
  explicit OpenHook(std::function<int(const char*)> hook);
  ~OpenHook();
  OpenHook(const OpenHook&) = delete;
  OpenHook& operator=(const OpenHook&) = delete;
};

#endif
