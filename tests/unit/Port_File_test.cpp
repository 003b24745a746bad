#include "Port_File.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <sys/stat.h>

#include <filesystem>
#include <fstream>
#include <string>
#include <utility>
#include <vector>

#include "OrdinaryUser.h"
#include "RepositoryBuilder.h"

namespace {

using Port::File;
using Port::Stream;
using namespace std::string_literals;

std::vector<std::string> ReadLines(const std::string& name) {
  std::vector<std::string> lines;
  Stream* const stream = File::open(name.c_str(), File::Read, false);
  if (!stream) return {"no stream"};
  Port::StringBase<char> line = "old";
  while (!stream->geteof()) {
    const int length = stream->readline(line);
    EXPECT_EQ(length, static_cast<int>(line.GetLength()));
    lines.emplace_back(line.View());
  }
  EXPECT_EQ(stream->readline(line), -1);
  EXPECT_EQ(line, "");
  EXPECT_TRUE(File::close(stream));
  return lines;
}

TEST(File, GivesTheLinesOfAnyContent) {
  const std::string longLine(300000, 'x');
  const std::pair<std::string, std::vector<std::string>> rows[] = {
      {"", {}},
      {"a", {"a"}},
      {"a\n", {"a"}},
      {"a\n\nb", {"a", "", "b"}},
      {"\n", {""}},
      {"\r\n", {""}},
      {"a\r\nb\r\n", {"a", "b"}},
      {"a\rb\n\r", {"a\rb", "\r"}},
      {"\r\r\n", {"\r"}},
      {"\xEF\xBB\xBF", {}},
      {"\xEF\xBB\xBF\n\xEF\xBB\xBFz", {"", "\xEF\xBB\xBFz"}},
      {"\xEF\xBBx", {"\xEF\xBBx"}},
      {"a\0b\xFF\n"s, {"a\0b\xFF"s}},
      {longLine + "\n" + longLine, {longLine, longLine}}};
  RepositoryBuilder directory;
  for (const auto& [content, lines] : rows) {
    directory.File("f", content);
    EXPECT_EQ(ReadLines(directory / "f"), lines);
  }
}

// Files whose length the system does not know beforehand.
TEST(File, ReadsFilesThatShowNoLength) {
  EXPECT_THAT(ReadLines("/proc/self/status"), testing::Contains(testing::StartsWith("Pid:")));
}

TEST(File, RefusesWhateverIsNoReadableFile) {
  RepositoryBuilder directory;
  const std::string pipe = directory / "pipe";
  ASSERT_EQ(::mkfifo(pipe.c_str(), 0644), 0);
  directory.File("secret", "x");
  std::filesystem::permissions(directory / "secret", std::filesystem::perms::none);
  const OrdinaryUser user;
  for (const std::string& name :
       {directory / "missing", directory.Path(), pipe, "/dev/zero"s, directory / "secret", ""s}) {
    EXPECT_FALSE(File::canread(name.c_str())) << name;
    EXPECT_EQ(File::open(name.c_str(), File::Read, false), nullptr) << name;
  }
  EXPECT_FALSE(File::close(nullptr));
}

}  // namespace
