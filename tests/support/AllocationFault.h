#ifndef ALLOCATIONFAULT_H
#define ALLOCATIONFAULT_H

// While one of these lives, the allocation that comes after `count` others in this thread fails,
// with std::bad_alloc or with something that no std::exception is; those behind it succeed again.
class AllocationFault {
 public:
  enum Kind { BadAlloc, SomethingElse };

  AllocationFault(int count, Kind kind);
  ~AllocationFault();
  AllocationFault(const AllocationFault&) = delete;
  AllocationFault& operator=(const AllocationFault&) = delete;

  // Whether the allocation came and failed.
  static bool Fired();
};

#endif
