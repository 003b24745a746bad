#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <atomic>
#include <memory>
#include <string>
#include <thread>
#include <vector>

#include "AllocationFault.h"
#include "MessageRecorder.h"
#include "Port_MsgManData.h"
#include "Tarvo_AppException.h"
#include "Tarvo_DebugMessenger.h"

namespace {

using Tarvo::AppException;
using Tarvo::DebugMessenger;
using Tarvo::DebugMessengerFactory;
using testing::ElementsAre;

Port_MsgManData& Object(int line = 7) {
  return Port_MsgManData::createObject("dom", "s/File", line, "2.5");
}

TEST(Messages, CarryTheirPlaceAndText) {
  MessageRecorder recorder;
  Object(7).issueWarning("%s at %d\n", "50%s", 3);
  Object(8).issueError("plain\n");
  Object(9).issueFatal(1, "%s", std::string(5000, 'x').c_str());
  EXPECT_THAT(recorder.Take(),
              ElementsAre("warning dom s/File 2.5: 50%s at 3\n", "error dom s/File 2.5: plain\n",
                          "fatal dom s/File 2.5: " + std::string(5000, 'x')));
  EXPECT_THAT(recorder.Lines(), ElementsAre(7, 8, 9));
}

TEST(Messages, AreWholeAtEveryLength) {
  MessageRecorder recorder;
  for (std::size_t length = 1000; length < 1050; ++length) {
    const std::string text(length, 'x');
    Object().issueError("%s", text.c_str());
    EXPECT_THAT(recorder.Take(), ElementsAre("error dom s/File 2.5: " + text));
    EXPECT_EQ(Port::StringBase<char>::doFormat("%s", text.c_str() + 770).View(), text.substr(770));
  }
}

TEST(Messages, GoToStandardErrorByDefault) {
  testing::internal::CaptureStderr();
  Object().issueWarning("w\n");
  Object().issueError("e\n");
  Object().issueFatal(1, "f\n");
  EXPECT_EQ(testing::internal::GetCapturedStderr(), "warning: w\nerror: e\nfatal error: f\n");
}

// A handler that throws loses nothing, and one may issue and exchange handlers itself.
TEST(Messages, SurviveTheirHandlers) {
  testing::internal::CaptureStderr();
  const std::string own(100, 'x');
  EXPECT_FALSE(Port_MsgManData::setHandler([own](const Port_Message& message) {
    Port_MsgManData::setHandler([](const Port_Message&) { throw 1; });
    Object().issueError("%s %s", own.c_str(), message.text);
  }));
  Object().issueWarning("outer\n");
  EXPECT_TRUE(Port_MsgManData::setHandler({}));
  EXPECT_EQ(testing::internal::GetCapturedStderr(), "error: " + own + " outer\n");
}

// Short texts need no memory, and a long one is cut when there is none for it.
TEST(Messages, ComeWithoutMemory) {
  std::string text(3000, 'x');
  std::string received;
  received.reserve(2 * text.size());
  Port_MsgManData::setHandler([&](const Port_Message& message) { received = message.text; });
  {
    const AllocationFault fault(0, AllocationFault::BadAlloc);
    Object().issueError("short %s\n", "text");
    EXPECT_EQ(received, "short text\n");
    Object().issueError("%s\n", text.c_str());
  }
  Port_MsgManData::setHandler({});
  EXPECT_TRUE(AllocationFault::Fired());
  EXPECT_THAT(received, testing::MatchesRegex("x+ \\.\\.\\.\n"));
  EXPECT_GT(received.size(), 1000U);
}

// Handlers and sinks are one at a time among threads, whichever calls the other.
TEST(Messages, AreSafeAmongThreads) {
  DebugMessenger* const logger = DebugMessengerFactory::GetLogger("threads");
  std::atomic<int> inside = 0;
  std::atomic<int> handled = 0;
  const auto handler = [&](const Port_Message&) {
    EXPECT_EQ(++inside, 1);
    if (++handled % 2 == 0) logger->Verbose("");
    --inside;
  };
  logger->SetSink([&](const auto&) { std::this_thread::yield(); });
  Port_MsgManData::setHandler(handler);
  const auto issue = [] {
    for (int i = 0; i < 2000; ++i) Object(i).issueError("%d\n", i);
  };
  const auto trace = [&] {
    for (int i = 0; i < 2000; ++i) logger->Verbose("");
  };
  std::thread threads[] = {std::thread(issue), std::thread(issue), std::thread(trace)};
  for (int i = 0; i < 200; ++i) Port_MsgManData::setHandler(handler);
  for (std::thread& thread : threads) thread.join();
  Port_MsgManData::setHandler({});
  logger->SetSink({});
  EXPECT_EQ(handled, 4000);
}

TEST(AppException, GivesTextAndLevelExactly) {
  const AppException exception(AppException::Failure, "Invalid %s\n");
  const std::exception& caught = exception;
  EXPECT_STREQ(caught.what(), "Invalid %s\n");
  EXPECT_EQ(AppException(exception).level, 1);
}

TEST(DebugMessenger, IsOneLoggerForEachName) {
  DebugMessenger* const logger = DebugMessengerFactory::GetLogger("test logger");
  ASSERT_NE(logger, nullptr);
  EXPECT_EQ(DebugMessengerFactory::GetLogger("test logger"), logger);
  EXPECT_NE(DebugMessengerFactory::GetLogger("another"), logger);
  EXPECT_TRUE(logger->IsOff());
  logger->Verbose("unheard\n");
  std::vector<std::string> heard;
  logger->SetSink([&](const Port::StringBase<char>& text) { heard.emplace_back(text); });
  EXPECT_FALSE(logger->IsOff());
  logger->Verbose("heard\n");
  logger->SetSink({});
  EXPECT_TRUE(logger->IsOff());
  EXPECT_THAT(heard, ElementsAre("heard\n"));
}

}  // namespace
