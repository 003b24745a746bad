#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <stdexcept>

#include "MessageRecorder.h"
#include "Tarvo_DebugMessenger.h"
#include "Tarvo_Guard.h"

namespace {

using namespace Tarvo;
using testing::ElementsAre;

constexpr Report::Module kModule{"s/Test", "2.0"};
constexpr int kFive = 5;

// The forms of a failure are in tests/data/operations.txt.
TEST(Guard, ReportsItsLineAndTheArgumentsAsTheyWere) {
  MessageRecorder recorder;
  StringBase output = "100%s";  // the argument lies in the output
  const int line = __LINE__ + 1;
  const auto failure = Failure(kModule, "No %s %d\n%s\n", output, kFive);
  EXPECT_FALSE(Guard(output, failure, [] { throw std::runtime_error("why %d\n"); }));
  EXPECT_EQ(output, "");
  EXPECT_THAT(recorder.Take(), ElementsAre("error s/Test 2.0: No 100%s 5\nwhy %d\n\n"));
  EXPECT_THAT(recorder.Lines(), ElementsAre(line));
}

// A trace asks first, and whatever happens to it stays with it.
TEST(Trace, ChangesNothingElse) {
  DebugMessenger& logger = *DebugMessengerFactory::GetLogger("BaseIP");
  int asked = 0;
  TARVO_TRACE("%d\n", ++asked);
  EXPECT_EQ(asked, 0);
  logger.SetSink([](const StringBase& text) {
    EXPECT_EQ(text, "1\n");
    throw 1;
  });
  TARVO_TRACE("%d\n", ++asked);
  logger.SetSink({});
  EXPECT_EQ(asked, 1);
}

// What the compiler refuses: conversions that don't fit, and a text without its line end.
static_assert(Report::Fits("%s %02d\n", "sd"));
static_assert(!Report::Fits("%s\n", "d"));
static_assert(!Report::Fits("%s\n", "ss"));
static_assert(!Report::Fits("%s %s\n", "s"));
static_assert(!Report::Fits("%s", "s"));
static_assert(!Report::Fits("100%\n", ""));

}  // namespace
