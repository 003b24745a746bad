#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <stdexcept>

#include "MessageRecorder.h"
#include "Tarvo_Guard.h"

namespace {

using namespace Tarvo;
using testing::ElementsAre;

constexpr Report::Module kModule{"s/Test", "1.0"};

template <class Thrown>
bool Fail(StringBase& output, WithoutText form, const Thrown& thrown) {
  const StringBase name = "100%s";
  return Guard(output,
               Failure(kModule, "Unable to do %s %d\n%s\n", name, 5).WithoutExceptionText(form),
               [&] {
                 EXPECT_EQ(output, "");
                 output = "half done";
                 throw thrown;
               });
}

TEST(Guard, TurnsWhateverIsThrownIntoAMessage) {
  MessageRecorder recorder;
  StringBase output = "old";
  EXPECT_FALSE(Fail(output, WithoutText::SaysUnknown, std::runtime_error("why %d\n")));
  EXPECT_EQ(output, "");
  EXPECT_FALSE(Fail(output, WithoutText::SaysUnknown, 1));
  EXPECT_FALSE(Fail(output, WithoutText::IsCutOff, 2));
  EXPECT_EQ(output, "");
  EXPECT_THAT(recorder.Take(),
              ElementsAre("error s/Test: Unable to do 100%s 5\nwhy %d\n\n",
                          "error s/Test: Unable to do 100%s 5, unknown exception\n",
                          "error s/Test: Unable to do 100%s 5\n"));
  EXPECT_THAT(recorder.Lines(), testing::Each(recorder.Lines().front()));
}

TEST(Guard, GivesWhatTheWorkGives) {
  StringList list = {"old"};
  const auto failure = Failure(kModule, "never\n%s\n");
  EXPECT_FALSE(Guard(list, failure, [] { return false; }));
  EXPECT_TRUE(Guard(list, failure, [&] { list.emplace_back("new"); }));
  EXPECT_THAT(list, ElementsAre("new"));
  EXPECT_EQ(GuardText(failure, [] { return "text"; }), "text");
}

// What the compiler refuses: conversions that don't fit, and a text without its line end.
static_assert(Report::Fits("%s %02d\n", "sd"));
static_assert(!Report::Fits("%s\n", "d"));
static_assert(!Report::Fits("%s\n", "ss"));
static_assert(!Report::Fits("%s %s\n", "s"));
static_assert(!Report::Fits("%s", "s"));
static_assert(!Report::Fits("100%\n", ""));

}  // namespace
