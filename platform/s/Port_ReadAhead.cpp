// The caller and its helpers share a queue. Whoever comes to a file first reads it: the caller
// never waits for a file that nobody has begun.

#include "Port_ReadAhead.h"

#include <pthread.h>
#include <unistd.h>

#include <chrono>
#include <condition_variable>
#include <csignal>
#include <deque>
#include <mutex>
#include <thread>
#include <utility>
#include <vector>

namespace Port {

namespace {

using Clock = std::chrono::steady_clock;

// What a look on a local disk takes seldom, and one over a network nearly always.
constexpr auto kSlow = std::chrono::microseconds(200);
// A look or two may be slow on any disk, or on a busy machine.
constexpr unsigned kSlowInARow = 8;
constexpr std::size_t kHelpers = 8;
constexpr std::size_t kMostAhead = 64;
constexpr std::size_t kLongest = std::size_t{256} * 1024;

struct Job {
  enum Progress { Waiting, Running, Read, Failed };

  std::string name;
  Progress progress = Waiting;
  FoundFile file;
};

// No signal is delivered to threads that are made in its lifetime.
class SignalsBlocked {
 public:
  SignalsBlocked() noexcept {
    sigset_t all;
    ::sigfillset(&all);
    ::pthread_sigmask(SIG_SETMASK, &all, &former);
  }
  ~SignalsBlocked() { ::pthread_sigmask(SIG_SETMASK, &former, nullptr); }
  SignalsBlocked(const SignalsBlocked&) = delete;
  SignalsBlocked& operator=(const SignalsBlocked&) = delete;

 private:
  sigset_t former = {};
};

// Nothing that goes wrong here is told: the caller looks again.
bool ReadJob(const std::string& name, FoundFile& file) noexcept {
  try {
    file = FoundFile(name.c_str());
    return file.ReadAhead(kLongest);
  } catch (...) {
    return false;
  }
}

}  // namespace

// All but the lock's holder keep their hands off the jobs, but for the name and the file of a
// running one, which are its helper's.
class ReadAhead::Helpers {
 public:
  // As many as can be had.
  Helpers() : owner(::getpid()) {
    threads.reserve(kHelpers);
    const SignalsBlocked blocked;
    try {
      for (std::size_t i = 0; i < kHelpers; ++i) threads.emplace_back([this] { Work(); });
    } catch (...) {
      // With fewer, or none, the caller reads more itself.
    }
  }
  ~Helpers() {
    {
      const std::lock_guard<std::mutex> lock(mutex);
      isOver = true;
    }
    changed.notify_all();
    for (std::thread& thread : threads) thread.join();
  }
  Helpers(const Helpers&) = delete;
  Helpers& operator=(const Helpers&) = delete;

  // False in a child of the process that made them: they did not come along, and one of them may
  // have held the lock.
  bool AreHere() const noexcept { return ::getpid() == owner; }

  void Add(Job& job) noexcept {
    try {
      const std::lock_guard<std::mutex> lock(mutex);
      waiting.push_back(&job);
    } catch (...) {
      return;  // left to the caller
    }
    changed.notify_one();
  }

  // Waits for a job that was begun, and takes any other out of the queue. True if it was read.
  bool Finish(Job& job) {
    std::unique_lock<std::mutex> lock(mutex);
    if (job.progress == Job::Waiting) std::erase(waiting, &job);
    done.wait(lock, [&] { return job.progress != Job::Running; });
    return job.progress == Job::Read;
  }

 private:
  void Work() {
    std::unique_lock<std::mutex> lock(mutex);
    while (true) {
      changed.wait(lock, [&] { return isOver || !waiting.empty(); });
      if (isOver) return;
      Job& job = *waiting.front();
      waiting.pop_front();
      job.progress = Job::Running;
      lock.unlock();
      const bool isRead = ReadJob(job.name, job.file);
      lock.lock();
      job.progress = isRead ? Job::Read : Job::Failed;
      done.notify_one();
    }
  }

  const pid_t owner;
  std::mutex mutex;
  std::condition_variable changed;
  std::condition_variable done;
  std::deque<Job*> waiting;
  bool isOver = false;
  std::vector<std::thread> threads;
};

struct ReadAhead::State {
  std::deque<Job> jobs;  // a reference to one stays good until it is taken
  unsigned slowInARow = 0;
  std::unique_ptr<Helpers> helpers;  // behind the jobs: they end first
};

ReadAhead::ReadAhead() : state(std::make_unique<State>()) {}

ReadAhead::~ReadAhead() {
  // What helpers left behind in another process can't be ended here.
  if (state->helpers && !state->helpers->AreHere()) static_cast<void>(state.release());
}

// In a child process all that helpers may have been busy with is left as it is.
bool ReadAhead::HasHelpers() {
  if (!state->helpers) return false;
  if (state->helpers->AreHere()) return true;
  auto alone = std::make_unique<State>();
  for (const Job& job : state->jobs) alone->jobs.emplace_back().name = job.name;
  static_cast<void>(state.release());
  state = std::move(alone);
  return false;
}

bool ReadAhead::HasRoom() const noexcept {
  return state->jobs.size() < (state->helpers ? kMostAhead : 1);
}

void ReadAhead::Expect(std::string name) {
  const bool hasHelpers = HasHelpers();
  Job& job = state->jobs.emplace_back();
  job.name = std::move(name);
  if (hasHelpers) state->helpers->Add(job);
}

std::size_t ReadAhead::CountExpected() const noexcept { return state->jobs.size(); }

FoundFile ReadAhead::Take() {
  const bool isRead = HasHelpers() && state->helpers->Finish(state->jobs.front());
  Job& job = state->jobs.front();
  FoundFile file = isRead ? std::move(job.file) : Look(job.name);
  state->jobs.pop_front();
  return file;
}

// Without memory for them there are none.
void ReadAhead::CallForHelp() noexcept {
  try {
    state->helpers = std::make_unique<Helpers>();
  } catch (...) {
    state->slowInARow = 0;
  }
}

// Looks for a file, and calls for help when that has been slow for long enough.
FoundFile ReadAhead::Look(const std::string& name) {
  const auto begin = Clock::now();
  FoundFile file(name.c_str());
  if (state->helpers) return file;
  const bool isSlow = Clock::now() - begin > kSlow;
  state->slowInARow = isSlow ? state->slowInARow + 1 : 0;
  if (state->slowInARow == kSlowInARow) CallForHelp();
  return file;
}

}  // namespace Port
