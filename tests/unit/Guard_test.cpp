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
constexpr int kLine = __LINE__ + 3;
template <class Thrown>
bool Fail(StringBase& output, const StringBase& name, ForUnknown form, const Thrown& thrown) {
  const auto failure = Failure(kModule, "No %s %d\n%s\n", name, kFive).With(form);
  return Guard(output, failure, [&] { throw thrown; });
}

TEST(Guard, TurnsWhateverIsThrownIntoAMessage) {
  MessageRecorder recorder;
  StringBase output = "100%s";  // the argument lies in the output
  EXPECT_FALSE(Fail(output, output, ForUnknown::SaySo, std::runtime_error("why %d\n")));
  EXPECT_EQ(output, "");
  output = "a";
  EXPECT_FALSE(Fail(output, output, ForUnknown::SaySo, 1));
  EXPECT_FALSE(Fail(output, "b", ForUnknown::CutOff, 2));
  EXPECT_FALSE(Fail(output, "c", ForUnknown::EmptyText, 3));
  EXPECT_THAT(recorder.Take(),
              ElementsAre("error s/Test 2.0: No 100%s 5\nwhy %d\n\n",
                          "error s/Test 2.0: No a 5, unknown exception\n",
                          "error s/Test 2.0: No b 5\n", "error s/Test 2.0: No c 5\n\n"));
  EXPECT_THAT(recorder.Lines(), ElementsAre(kLine, kLine, kLine, kLine));
}

TEST(Guard, GivesWhatTheWorkGives) {
  StringList list = {"old"};
  const auto failure = Failure(kModule, "never\n%s\n");
  EXPECT_FALSE(Guard(list, failure, [] { return false; }));
  EXPECT_TRUE(Guard(list, failure, [&] { list = {"new"}; }));
  EXPECT_THAT(list, ElementsAre("new"));
  EXPECT_EQ(GuardText(failure, [] { return "text"; }), "text");
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
