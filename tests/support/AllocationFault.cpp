#include "AllocationFault.h"

#include <cstddef>
#include <cstdlib>
#include <new>

#include "Tarvo_AppException.h"

namespace {

constexpr int kNone = -1;

thread_local int remaining = kNone;
thread_local AllocationFault::Kind kindOfFault = AllocationFault::BadAlloc;
thread_local bool fired = false;

// Null for the allocation that is to fail.
void* Allocate(std::size_t size) noexcept {
  if (remaining == kNone || remaining-- > 0) return std::malloc(size ? size : 1);
  fired = true;
  return nullptr;
}

void* AllocateOrThrow(std::size_t size) {
  if (void* const memory = Allocate(size)) return memory;
  if (kindOfFault == AllocationFault::SomethingElse) throw 1;  // no std::exception on purpose
  if (kindOfFault == AllocationFault::FatalException) {
    throw Tarvo::AppException(Tarvo::AppException::Fatal, "out of order\n");
  }
  throw std::bad_alloc();
}

}  // namespace

AllocationFault::AllocationFault(int count, Kind kind) {
  fired = false;
  kindOfFault = kind;
  remaining = count;
}

AllocationFault::~AllocationFault() { remaining = kNone; }

bool AllocationFault::Fired() { return fired; }

// The allocations of the whole program, those of shared libraries included. All forms in use are
// here, since a sanitizer would bring its own for the others.
void* operator new(std::size_t size) { return AllocateOrThrow(size); }
void* operator new[](std::size_t size) { return AllocateOrThrow(size); }
void* operator new(std::size_t size, const std::nothrow_t&) noexcept { return Allocate(size); }
void* operator new[](std::size_t size, const std::nothrow_t&) noexcept { return Allocate(size); }
void operator delete(void* memory) noexcept { std::free(memory); }
void operator delete[](void* memory) noexcept { std::free(memory); }
void operator delete(void* memory, std::size_t) noexcept { std::free(memory); }
void operator delete[](void* memory, std::size_t) noexcept { std::free(memory); }
