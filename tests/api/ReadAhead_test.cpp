// Walks over a slow disk, where helpers read ahead: what they tell and find is that of one reader.

#include <gtest/gtest.h>
#include <signal.h>
#include <sys/wait.h>
#include <unistd.h>

#include <atomic>
#include <cerrno>
#include <chrono>
#include <filesystem>
#include <mutex>
#include <set>
#include <string>
#include <thread>
#include <vector>

#include "OpenHook.h"
#include "Port_MsgManData.h"
#include "RepositoryBuilder.h"
#include "Tarvo_KelLibrary.h"

namespace {

using namespace Tarvo;
namespace fs = std::filesystem;

constexpr int kCores = 120;

// Some that have a fault, or what is read in another way, among many that have none.
void Make(RepositoryBuilder& repo) {
  for (int i = 0; i < kCores; ++i) {
    auto core = repo.Core("c" + std::to_string(i) + "_v1_00_a");
    const std::string name = "data/c" + std::to_string(i) + "_v2_1_0.qvr";
    if (i % 10 == 1) continue;
    core.Qvr("OPTION DESC = " + std::to_string(i) + (i % 10 == 2 ? "\nOPTION bad" : ""));
    if (i % 10 == 3) fs::resize_file(core.Location() + "/" + name, 300'000);
    if (i % 10 == 4) {
      fs::rename(core.Location() + "/" + name, core.Location() + "/data/other");
      fs::create_symlink("other", core.Location() + "/" + name);
    }
    if (i % 10 == 5) fs::remove_all(core.Location());
    if (i % 10 == 5) repo.File("ipmods/c" + std::to_string(i) + "_v1_00_a", "");
  }
}

// Whether the thread sanitizer is there, as either compiler says it.
#if defined(__has_feature)
#if __has_feature(thread_sanitizer)
#define KEL_THREAD_SANITIZER
#endif
#endif

// What a walk tells, and what it finds.
std::vector<std::string> Walk(const RepositoryBuilder& repo) {
  std::vector<std::string> told;
  const auto previous = Port_MsgManData::setHandler(
      [&](const Port_Message& message) { told.emplace_back(message.text); });
  KelLibrary library;
  told.emplace_back(library.SetRepositoryPath(repo.Path().c_str()) ? "complete" : "not complete");
  Port_MsgManData::setHandler(previous);
  StringList keys;
  library.ListAllIPKeys(keys);
  for (const StringBase& key : keys) {
    StringBase text;
    library.GetIPProperty(key, "DESC", text);
    told.push_back(std::string(key.View()) + ": " + std::string(text.View()));
  }
  return told;
}

void WaitLikeANetwork() { std::this_thread::sleep_for(std::chrono::microseconds(400)); }

// Who opened files while it lived.
class SlowDisk {
 public:
  // `fail` gives the error number for a path, or 0.
  explicit SlowDisk(int (*fail)(const char*) = [](const char*) { return 0; })
      : hook([this, fail](const char* path) {
          {
            const std::lock_guard<std::mutex> lock(mutex);
            threads.insert(std::this_thread::get_id());
          }
          WaitLikeANetwork();
          return fail(path);
        }) {}

  std::size_t CountThreads() const { return threads.size(); }

 private:
  std::mutex mutex;
  std::set<std::thread::id> threads;
  OpenHook hook;
};

class ReadAhead : public testing::Test {
 protected:
  ReadAhead() { Make(repo); }

  RepositoryBuilder repo;
};

TEST_F(ReadAhead, TellsWhatOneReaderTells) {
  const std::vector<std::string> alone = Walk(repo);
  EXPECT_GT(alone.size(), kCores / 2U);
  const SlowDisk disk;
  EXPECT_EQ(Walk(repo), alone);
  EXPECT_GT(disk.CountThreads(), 2U);
}

TEST_F(ReadAhead, NeedsNoThreadOnAFastDisk) {
  std::atomic<int> others = 0;
  const auto self = std::this_thread::get_id();
  const OpenHook hook([&](const char*) {
    others += std::this_thread::get_id() == self ? 0 : 1;
    return 0;
  });
  Walk(repo);
  EXPECT_EQ(others, 0);
}

// A helper may meet an error that is over when the walk comes to the file; the walk's own counts.
TEST_F(ReadAhead, TellsErrorsOfItsOwnThreadAlone) {
  const std::vector<std::string> alone = Walk(repo);
  static std::thread::id self;
  self = std::this_thread::get_id();
  {
    const SlowDisk disk([](const char*) {
      return std::this_thread::get_id() == self ? 0 : std::rand() % 2 == 0 ? EMFILE : EIO;
    });
    EXPECT_EQ(Walk(repo), alone);
  }
  const auto refuse = [](const char* path) {
    return std::string(path).find("c7") == std::string::npos ? 0 : EIO;
  };
  std::vector<std::string> refused;
  {
    const OpenHook hook(refuse);
    refused = Walk(repo);
  }
  EXPECT_NE(refused, alone);
  const SlowDisk disk(refuse);
  EXPECT_EQ(Walk(repo), refused);
}

// Files vanish and come back, and the handler of messages is exchanged: whatever is found, nothing
// breaks, and later all is found again.
TEST_F(ReadAhead, LivesThroughChanges) {
  const std::vector<std::string> alone = Walk(repo);
  std::atomic<int> told = 0;
  const auto handle = [&](const Port_Message&) { ++told; };
  const auto previous = Port_MsgManData::setHandler(handle);
  std::atomic<bool> isOver = false;
  std::thread changes([&] {
    while (!isOver) {
      for (int i = 6; i < kCores; i += 10) {
        const fs::path data = repo / ("ipmods/c" + std::to_string(i) + "_v1_00_a/data");
        fs::rename(data, data.string() + "-");
        Port_MsgManData::setHandler(handle);
        fs::rename(data.string() + "-", data);
      }
    }
  });
  {
    const SlowDisk disk;
    for (int round = 0; round < 5; ++round) KelLibrary().SetRepositoryPath(repo.Path().c_str());
  }
  isOver = true;
  changes.join();
  Port_MsgManData::setHandler(previous);
  EXPECT_GT(told, 0);
  EXPECT_EQ(Walk(repo), alone);
}

// Whoever walks forks in the middle of it; the child goes on without the helpers. They are given
// the time to come to rest, opening a file or without work: a sanitizer's own locks, which they may
// hold elsewhere, would come along into the child.
TEST_F(ReadAhead, GoesOnInAChild) {
#if defined(__SANITIZE_THREAD__) || defined(KEL_THREAD_SANITIZER)
  GTEST_SKIP() << "the thread sanitizer allows no threads in such a child";
#endif
  const std::vector<std::string> alone = Walk(repo);
  const auto self = std::this_thread::get_id();
  std::atomic<bool> isHelped = false;
  std::atomic<bool> isForking = false;
  pid_t child = -1;
  const auto forkOnce = [&] {
    if (!isHelped || child != -1) return;
    isForking = true;
    std::this_thread::sleep_for(std::chrono::milliseconds(200));
    child = ::fork();
    isForking = false;
  };
  std::vector<std::string> told;
  {
    const OpenHook hook([&](const char*) {
      WaitLikeANetwork();
      if (std::this_thread::get_id() == self) {
        forkOnce();
      } else {
        isHelped = true;
        while (isForking) WaitLikeANetwork();
      }
      return 0;
    });
    told = Walk(repo);
  }
  if (child == 0) ::_exit(told == alone ? 0 : 1);
  EXPECT_EQ(told, alone);
  int status = 0;
  ASSERT_EQ(::waitpid(child, &status, 0), child);
  EXPECT_TRUE(WIFEXITED(status) && WEXITSTATUS(status) == 0) << status;
}

// Signals of the process come to the caller's threads.
TEST_F(ReadAhead, TakesNoSignals) {
  static std::thread::id self;
  static std::atomic<int> elsewhere, here;
  self = std::this_thread::get_id();
  struct sigaction action = {};
  action.sa_handler = [](int) { ++(std::this_thread::get_id() == self ? here : elsewhere); };
  action.sa_flags = SA_RESTART;
  struct sigaction former = {};
  ASSERT_EQ(::sigaction(SIGUSR1, &action, &former), 0);
  {
    const SlowDisk disk([](const char*) {
      // While another thread is there that could take it.
      if (std::this_thread::get_id() != self) ::kill(::getpid(), SIGUSR1);
      return 0;
    });
    Walk(repo);
  }
  ::sigaction(SIGUSR1, &former, nullptr);
  EXPECT_GT(here, 0);
  EXPECT_EQ(elsewhere, 0);
}

}  // namespace
