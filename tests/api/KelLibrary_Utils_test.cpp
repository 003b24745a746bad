#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>

#include "RepositoryBuilder.h"
#include "Tarvo_AppException.h"
#include "Tarvo_KelLibrary_Utils.h"

namespace {

using namespace Tarvo;

std::string Dump(const StringList& list) {
  std::string text;
  for (const StringBase& entry : list) text += "<" + std::string(entry) + ">";
  return text;
}

TEST(KelLibrary_Utils, SplitsInterfaceNames) {
  const char* const rows[][2] = {{"", ""},
                                 {":::", ""},
                                 {"SLAVE0", "<SLAVE0>"},
                                 {"SLAVE0:SLAVE1", "<SLAVE0><SLAVE1>"},
                                 {":B::A:A: ;\"x", "<B><A><A>< ;\"x>"}};
  for (const auto& [text, pieces] : rows) {
    EXPECT_EQ(Dump(KelLibrary_Utils::GetInterfaceVector(text)), pieces);
  }
}

TEST(KelLibrary_Utils, SplitsAndTestsPaths) {
  RepositoryBuilder directory;
  const std::string good = directory.Path();
  directory.File("plain", "");
  const auto split = [](const std::string& path) {
    try {
      return Dump(KelLibrary_Utils::GetPathVector(path.c_str()));
    } catch (const AppException& exception) {
      return std::to_string(exception.level) + " " + exception.what();
    }
  };
  EXPECT_EQ(split(""), "");
  EXPECT_EQ(split(";;;"), "");
  EXPECT_EQ(split(good + ";;" + good + "/;"), "<" + good + "><" + good + "/>");
  EXPECT_EQ(split(good + "; " + good), "1 Invalid path directory  " + good + "\n");
  EXPECT_THROW(KelLibrary_Utils::GetPathVector(StringBase((good + '\0').append("x"))),
               AppException);
  EXPECT_EQ(split(good + "/plain"), "1 Invalid path directory " + good + "/plain\n");
  EXPECT_EQ(split(good + ";%s;/nowhere"), "1 Invalid path directory %s\n");
  EXPECT_EQ(split(good + ":" + good), "1 Invalid path directory " + good + ":" + good + "\n");
}

}  // namespace
