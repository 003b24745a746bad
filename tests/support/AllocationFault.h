#ifndef ALLOCATIONFAULT_H
#define ALLOCATIONFAULT_H

// While one of these lives, the allocation that comes after `count` others in this thread fails
// (none for -1), with std::bad_alloc, with something that is no std::exception, or with an
// AppException of level Fatal; those behind it succeed again.
class AllocationFault {
 public:
  enum Kind { BadAlloc, SomethingElse, FatalException };

  AllocationFault(int count, Kind kind);
  ~AllocationFault();
  AllocationFault(const AllocationFault&) = delete;
  AllocationFault& operator=(const AllocationFault&) = delete;

  // Whether the allocation came and failed.
  static bool Fired();
};

#endif
