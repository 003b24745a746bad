#ifndef PORT_EXPORT_H
#define PORT_EXPORT_H

// Marks a class that the platform library exports, and the members of it that stay hidden. What
// bears no mark is hidden.
#define PORT_EXPORT __attribute__((visibility("default")))
#define PORT_LOCAL __attribute__((visibility("hidden")))

// Lets the compiler check a printf-style format against the arguments behind it. Positions count
// from 1, and a non-static member function has its object in front of them.
#define PORT_PRINTF(formatPosition, firstArgument) \
  __attribute__((format(printf, formatPosition, firstArgument)))

// Lets a compiler that knows how warn of a view that outlives the object it looks into.
#ifdef __clang__
#define PORT_LIFETIME_BOUND [[clang::lifetimebound]]
#else
#define PORT_LIFETIME_BOUND
#endif

#endif
