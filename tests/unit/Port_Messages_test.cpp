#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>

#include "AllocationFault.h"
#include "MessageRecorder.h"
#include "Port_MsgManData.h"
#include "Tarvo_DebugMessenger.h"

namespace {

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

// A handler that throws loses nothing, and one may issue and exchange handlers itself. Without one,
// messages go to standard error.
TEST(Messages, SurviveTheirHandlers) {
  testing::internal::CaptureStderr();
  const std::string own(100, 'x');
  EXPECT_FALSE(Port_MsgManData::setHandler([own](const Port_Message& message) {
    Port_MsgManData::setHandler([](const Port_Message&) { throw 1; });
    Object().issueError("%s %s", own.c_str(), message.text);
  }));
  Object().issueWarning("outer\n");
  EXPECT_TRUE(Port_MsgManData::setHandler({}));
  Object().issueWarning("w\n");
  Object().issueFatal(1, "f\n");
  EXPECT_EQ(testing::internal::GetCapturedStderr(),
            "error: " + own + " outer\nwarning: w\nfatal error: f\n");
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

TEST(DebugMessenger, IsOneLoggerForEachName) {
  DebugMessenger* const logger = DebugMessengerFactory::GetLogger("test logger");
  EXPECT_EQ(DebugMessengerFactory::GetLogger("test logger"), logger);
  EXPECT_NE(DebugMessengerFactory::GetLogger("another"), logger);
  logger->Verbose("unheard\n");
  std::string heard;
  logger->SetSink([&](const Port::StringBase<char>& text) { heard += text; });
  EXPECT_FALSE(logger->IsOff());
  logger->Verbose("heard\n");
  logger->SetSink({});
  EXPECT_TRUE(logger->IsOff());
  EXPECT_EQ(heard, "heard\n");
}

}  // namespace
