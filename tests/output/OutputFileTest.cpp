#include "output/OutputFile.h"

#include <gtest/gtest.h>

#include <csignal>
#include <filesystem>
#include <sys/resource.h>
#include <sys/stat.h>

#include "core/Errors.h"
#include "support/TestProgram.h"

namespace molvar {
namespace {

namespace fs = std::filesystem;
using testing::ReadFile;
using testing::TempFolder;
using testing::WriteFile;

std::size_t EntriesIn(const fs::path& folder) {
  return static_cast<std::size_t>(std::distance(fs::directory_iterator(folder), fs::directory_iterator()));
}

TEST(OutputFile, LinesEndWithCrLfAndReplaceTheTargetOnClose) {
  TempFolder dir;
  const std::string path = dir.File("out.kml");
  WriteFile(path, "previous");
  OutputFile out;
  out.Open(path);
  out.Line("<kml>");
  out.Text() += "a";
  out.Text() += "b";
  out.EndLine();
  out.Raw("x\r\n");
  EXPECT_EQ(ReadFile(path), "previous");  // nothing visible before the close
  out.Close();
  EXPECT_EQ(ReadFile(path), "<kml>\r\nab\r\nx\r\n");
  EXPECT_EQ(EntriesIn(dir.path()), 1u);  // no temporary file left behind
  EXPECT_EQ(out.CompletedCount(), 1);
}

TEST(OutputFile, AbandonKeepsThePreviousFile) {
  TempFolder dir;
  const std::string path = dir.File("out.kml");
  WriteFile(path, "previous");
  {
    OutputFile out;
    out.Open(path);
    out.Line("half a file");
  }  // destroyed while open
  EXPECT_EQ(ReadFile(path), "previous");
  EXPECT_EQ(EntriesIn(dir.path()), 1u);
}

TEST(OutputFile, MissingFolderIsAClearError) {
  TempFolder dir;
  OutputFile out;
  try {
    out.Open(dir.File("no/such/folder/out.kml"));
    ADD_FAILURE();
  } catch (const RuntimeError& e) {
    EXPECT_EQ(e.Number(), kErrPathNotFound);
    EXPECT_NE(std::string(e.what()).find("out.kml"), std::string::npos);
  }
  EXPECT_FALSE(out.IsOpen());
}

TEST(OutputFile, FailedWriteLeavesThePreviousFileIntact) {
  TempFolder dir;
  const std::string path = dir.File("big.kml");
  WriteFile(path, "previous");
  // A file size limit makes writes fail the way a full disk does.
  std::signal(SIGXFSZ, SIG_IGN);
  rlimit old{};
  ASSERT_EQ(getrlimit(RLIMIT_FSIZE, &old), 0);
  rlimit small = old;
  small.rlim_cur = 4096;
  ASSERT_EQ(setrlimit(RLIMIT_FSIZE, &small), 0);
  OutputFile out;
  out.Open(path);
  const std::string line(1000, 'x');
  bool failed = false;
  try {
    for (int i = 0; i < 5000; ++i) out.Line(line);
    out.Close();
  } catch (const RuntimeError& e) {
    failed = true;
    EXPECT_NE(std::string(e.what()).find("big.kml"), std::string::npos);
  }
  setrlimit(RLIMIT_FSIZE, &old);
  EXPECT_TRUE(failed);
  EXPECT_EQ(ReadFile(path), "previous");
  EXPECT_EQ(EntriesIn(dir.path()), 1u);
  EXPECT_EQ(out.CompletedCount(), 0);
}

TEST(OutputFile, PrivateFilesAreOwnerOnly) {
  TempFolder dir;
  const std::string path = dir.File("Molvar.ini");
  WriteFileAtomically(path, "00=x\r\n", true, true);
  struct stat st{};
  ASSERT_EQ(::stat(path.c_str(), &st), 0);
  EXPECT_EQ(st.st_mode & 0777, 0600u);
  EXPECT_EQ(ReadFile(path), "00=x\r\n");
}

}  // namespace
}  // namespace molvar
