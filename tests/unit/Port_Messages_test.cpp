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
              ElementsAre("warning dom s/File: 50%s at 3\n", "error dom s/File: plain\n",
                          "fatal dom s/File: " + std::string(5000, 'x')));
  EXPECT_THAT(recorder.Lines(), ElementsAre(7, 8, 9));
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
  EXPECT_FALSE(Port_MsgManData::setHandler([](const Port_Message& message) {
    const std::string text = message.text;
    Port_MsgManData::setHandler([](const Port_Message&) { throw 1; });
    Object().issueError("inner %s", text.c_str());
  }));
  Object().issueWarning("outer\n");
  EXPECT_TRUE(Port_MsgManData::setHandler({}));
  EXPECT_EQ(testing::internal::GetCapturedStderr(), "error: inner outer\n");
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

TEST(Messages, AreSafeAmongThreads) {
  std::atomic<int> handled = 0;
  int unguarded = 0;  // handler calls never overlap, so no race on this one
  const auto count = [&](const Port_Message&) { handled += ++unguarded > 0 ? 1 : 0; };
  Port_MsgManData::setHandler(count);
  const auto issue = [] {
    for (int i = 0; i < 2000; ++i) Object(i).issueError("%d\n", i);
  };
  std::thread first(issue);
  std::thread second(issue);
  for (int i = 0; i < 200; ++i) Port_MsgManData::setHandler(count);
  first.join();
  second.join();
  Port_MsgManData::setHandler({});
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
