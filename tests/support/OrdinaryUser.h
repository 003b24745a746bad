#ifndef ORDINARYUSER_H
#define ORDINARYUSER_H

#include <unistd.h>

// While one of these lives, the process has no right that an ordinary user has not, so that
// permissions count also when the tests run as root.
class OrdinaryUser {
 public:
  OrdinaryUser() { changed = ::geteuid() == 0 && ::seteuid(kNobody) == 0; }
  ~OrdinaryUser() {
    if (changed && ::seteuid(0) != 0) ::_exit(1);
  }
  OrdinaryUser(const OrdinaryUser&) = delete;
  OrdinaryUser& operator=(const OrdinaryUser&) = delete;

 private:
  static constexpr uid_t kNobody = 65534;

  bool changed = false;
};

#endif
