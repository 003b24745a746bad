#ifndef KEL_STATUS_H
#define KEL_STATUS_H

// Exit statuses of the command.
enum Status {
  StatusClean = 0,
  StatusFindings = 1,   // a key was not found, or a message was an error
  StatusUsage = 2,      // usage error
  StatusUnreadable = 3  // the repository path can't be set
};

#endif
