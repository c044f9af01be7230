#include "input/LineReader.h"

#include <gtest/gtest.h>

#include <vector>

#include "core/Errors.h"
#include "support/TestProgram.h"

namespace molvar {
namespace {

std::vector<std::string> AllLines(const std::string& path) {
  LineReader reader(path);
  std::vector<std::string> lines;
  std::string line;
  while (reader.Next(line)) lines.push_back(line);
  return lines;
}

TEST(LineReader, EveryLineEndStyle) {
  testing::TempFolder dir;
  const std::string path = dir.File("t.txt");
  testing::WriteFile(path, "a\r\nb\rc\nd\r\n\r\ne");
  EXPECT_EQ(AllLines(path), (std::vector<std::string>{"a", "b", "c", "d", "", "e"}));
  testing::WriteFile(path, "x\r\n");
  EXPECT_EQ(AllLines(path), (std::vector<std::string>{"x"}));
  testing::WriteFile(path, "");
  EXPECT_TRUE(AllLines(path).empty());
  testing::WriteFile(path, std::string("\0\xff\r\n\0", 5));
  EXPECT_EQ(AllLines(path), (std::vector<std::string>{std::string("\0\xff", 2), std::string("\0", 1)}));
}

TEST(LineReader, CrLfSplitAcrossBufferEdge) {
  testing::TempFolder dir;
  const std::string path = dir.File("t.txt");
  std::string content((1 << 20) - 1, 'a');
  content += "\r\nb\r\n";
  testing::WriteFile(path, content);
  auto lines = AllLines(path);
  ASSERT_EQ(lines.size(), 2u);
  EXPECT_EQ(lines[0].size(), (1u << 20) - 1);
  EXPECT_EQ(lines[1], "b");
}

TEST(LineReader, HugeLineIsCut) {
  testing::TempFolder dir;
  const std::string path = dir.File("t.txt");
  std::string content(3 << 20, 'z');
  content += "\nnext";
  testing::WriteFile(path, content);
  auto lines = AllLines(path);
  ASSERT_EQ(lines.size(), 2u);
  EXPECT_EQ(lines[0].size(), LineReader::kMaxLineLength);
  EXPECT_EQ(lines[1], "next");
}

TEST(LineReader, MissingFileNamesThePath) {
  try {
    LineReader reader("/nonexistent/dir/file.plt");
    ADD_FAILURE();
  } catch (const RuntimeError& e) {
    EXPECT_EQ(e.Number(), kErrFileNotFound);
    EXPECT_NE(std::string(e.what()).find("/nonexistent/dir/file.plt"), std::string::npos);
  }
}

}  // namespace
}  // namespace molvar
