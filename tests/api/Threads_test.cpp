// Requests in several threads at once, for the thread sanitizer.

#include <gtest/gtest.h>

#include <atomic>
#include <memory>
#include <thread>
#include <utility>

#include "Port_MsgManData.h"
#include "RepositoryBuilder.h"
#include "Tarvo_DebugMessenger.h"
#include "Tarvo_KelIP.h"
#include "Tarvo_KelLibrary.h"

namespace {

using namespace Tarvo;

bool Request(const StringBase& path) {
  KelLibrary library;
  if (!library.SetRepositoryPath(path) || library.GetLocation("missing").GetLength() > 0) {
    return false;
  }
  const std::unique_ptr<KelIP> ip(library.CreateIP("abc"));
  StringList sources;
  StringList netlists;
  return ip && ip->ListSynthesisSources(sources) && sources.size() == 2 &&
         ip->ListNetlists(netlists) && netlists.size() == 1;
}

// Each thread has a library of its own; the handler of messages and the logger are for all, run one
// at a time, and are exchanged meanwhile.
TEST(Threads, ShareOnlyHandlerAndLogger) {
  RepositoryBuilder repo;
  repo.Core("abc_v1_00_a")
      .Qvr("OPTION STYLE = MIX\nPARAMETER MODE = FAST")
      .Ldx("lib abc a.vhd\nlib def all\nlib abc a.vhd")
      .Tew("MODE FILES\nFAST a.edif");
  repo.Core("def_v1_00_a").Ldx("lib def b.vhd");
  const StringBase path = repo.Path().c_str();
  std::atomic<int> wrong = 0, running = 3, inside = 0;
  const auto request = [&] {
    for (int round = 0; round < 50; ++round) wrong += Request(path) ? 0 : 1;
    --running;
  };
  std::thread threads[] = {std::thread(request), std::thread(request), std::thread(request)};
  DebugMessenger& logger = *DebugMessengerFactory::GetLogger("BaseIP");
  const auto handle = [&](const Port_Message&) {
    wrong += ++inside == 1 ? 0 : 1;
    logger.Verbose("from within");
    --inside;
  };
  while (running > 0) {
    auto previous = Port_MsgManData::setHandler(handle);
    logger.SetSink([](const StringBase&) { std::this_thread::yield(); });
    logger.SetSink({});
    Port_MsgManData::setHandler(std::move(previous));
  }
  for (std::thread& thread : threads) thread.join();
  EXPECT_EQ(wrong, 0);
}

}  // namespace
