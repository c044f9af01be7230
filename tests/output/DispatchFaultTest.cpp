// The track dispatcher when its file cannot be written: a full disk at every stage of the file and
// a folder that refuses new files. The previous file stays byte for byte, nothing is left behind,
// the message names the file and the reason, and the next write succeeds.
#include <gtest/gtest.h>

#include <cstdio>
#include <filesystem>

#include "core/Text.h"
#include "output/Dispatch.h"
#include "support/Faults.h"
#include "support/TestProgram.h"

namespace molvar {
namespace {

namespace fs = std::filesystem;
using testing::CutPoints;
using testing::FileSizeLimit;
using testing::NamesIn;
using testing::ReadFile;
using testing::TestProgram;
using testing::WriteFile;

constexpr const char* kPrevious = "the previous file, not ours to lose\r\n";

struct Format {
  const char* name;
  int16_t format;
  const char* failing;  // the procedure that reports the failed close
};
const Format kFormats[] = {
    {"t.kml", kFormatKml, "WriteKmlFooter"}, {"t.gpx", kFormatGpx, "WriteOutputFile"}, {"t.plt", kFormatOzi, "WriteOutputFile"}};

struct FaultyDispatch : TestProgram {
  explicit FaultyDispatch(int points = 3) {
    m->frmMain.chkAuto.Value = 0;
    fs::create_directory(out);
    // One point a second from 01:00:00 AM.
    for (int i = 0; i < points; ++i) {
      char time[32];
      std::snprintf(time, sizeof time, "2007-06-01 %02d:%02d:%02d AM", 1 + i / 3600, i / 60 % 60, i % 60);
      AddPoint(45.0 + i * 0.0001, -75.0, time);
    }
  }
  // Writes `name` and returns the messages shown meanwhile.
  std::vector<RecordedCall> Write(const fs::path& target, int16_t format) {
    platform.calls.clear();
    m->frmMain.txtInfo.Text.clear();
    m->OutputPath = target.string();
    m->OutputName = target.filename().string();
    m->OutputFormat = format;
    WriteOutputFile(*m);
    return platform.Messages();
  }
  fs::path out = folder.path() / "out";
};

TEST(DispatchFault, DiskFullAtEveryStageKeepsThePreviousFile) {
  for (const Format& f : kFormats) {
    FaultyDispatch d;
    const fs::path target = d.out / f.name;
    ASSERT_TRUE(d.Write(target, f.format).empty());
    const std::string complete = ReadFile(target.string());
    for (const std::size_t cut : CutPoints(complete.size())) {
      const std::string what = std::string(f.name) + " cut at " + std::to_string(cut);
      WriteFile(target.string(), kPrevious);
      const int completed = d->Out.CompletedCount();
      std::vector<RecordedCall> messages;
      {
        FileSizeLimit full(cut);
        messages = d.Write(target, f.format);
      }
      ASSERT_EQ(messages.size(), 1u) << what;
      EXPECT_EQ(messages[0].title, "Error");
      EXPECT_EQ(messages[0].text, std::string(f.failing) + " bug Path/File access error (" + target.string() +
                                      ": File too large)")
          << what;
      EXPECT_EQ(ReadFile(target.string()), kPrevious) << what;
      EXPECT_EQ(NamesIn(d.out), std::vector<std::string>{f.name}) << what << ": no temporary file stays";
      EXPECT_EQ(d->Out.CompletedCount(), completed) << what;
      EXPECT_FALSE(d->Out.IsOpen()) << what;
      EXPECT_FALSE(Contains(d->frmMain.txtInfo.Text, "Output:")) << what << ": " << d->frmMain.txtInfo.Text;
    }
    // Room again: the same program writes the same file.
    EXPECT_TRUE(d.Write(target, f.format).empty());
    EXPECT_EQ(ReadFile(target.string()), complete);
    EXPECT_EQ(NamesIn(d.out), std::vector<std::string>{f.name});
  }
}

// A file larger than the write buffer meets the full disk in the middle, not at its close.
TEST(DispatchFault, DiskFullInTheMiddleOfALargeFile) {
  FaultyDispatch d(4000);
  const fs::path target = d.out / "big.kml";
  ASSERT_TRUE(d.Write(target, kFormatKml).empty());
  const std::string complete = ReadFile(target.string());
  ASSERT_GT(complete.size(), 1u << 20) << "the file must be larger than the write buffer";
  WriteFile(target.string(), kPrevious);
  std::vector<RecordedCall> messages;
  {
    FileSizeLimit full(complete.size() / 2);
    messages = d.Write(target, kFormatKml);
  }
  ASSERT_EQ(messages.size(), 1u);
  EXPECT_EQ(messages[0].text, "WriteKmlFooter bug Path/File access error (" + target.string() + ": File too large)");
  EXPECT_EQ(ReadFile(target.string()), kPrevious);
  EXPECT_EQ(NamesIn(d.out), std::vector<std::string>{"big.kml"});
  EXPECT_TRUE(d.Write(target, kFormatKml).empty());
  EXPECT_EQ(ReadFile(target.string()), complete);
}

// Without write permission (or, for root, whom no folder mode stops, under a path that runs
// through a plain file) the head cannot even start: one message naming the file, nothing written.
TEST(DispatchFault, FolderThatTakesNoNewFile) {
  for (const Format& f : kFormats) {
    FaultyDispatch d;
    fs::path target = d.out / f.name;
    std::string reason = "Permission denied (" + target.string() + ": Permission denied)";
    WriteFile(target.string(), kPrevious);
    std::vector<RecordedCall> messages;
    if (testing::RunningAsRoot()) {
      WriteFile((d.out / "plain").string(), "a file, not a folder");
      target = d.out / "plain" / f.name;
      reason = "Path not found (" + target.string() + ": Not a directory)";
      messages = d.Write(target, f.format);
    } else {
      testing::ReadOnlyFolder readOnly(d.out);
      messages = d.Write(target, f.format);
    }
    const std::string head = f.format == kFormatKml ? "WriteKmlHeader" : "WriteOutputFile";
    ASSERT_EQ(messages.size(), 1u) << f.name;
    EXPECT_EQ(messages[0].text, head + " bug " + reason);
    EXPECT_EQ(ReadFile((d.out / f.name).string()), kPrevious);
    EXPECT_EQ(d->Out.CompletedCount(), 0);
    EXPECT_FALSE(Contains(d->frmMain.txtInfo.Text, "Output:")) << d->frmMain.txtInfo.Text;
    const std::vector<std::string> expected =
        testing::RunningAsRoot() ? std::vector<std::string>{"plain", f.name} : std::vector<std::string>{f.name};
    EXPECT_EQ(NamesIn(d.out), expected);
    // Permission back (or a real folder): the next write goes through.
    EXPECT_TRUE(d.Write(d.out / f.name, f.format).empty());
    EXPECT_NE(ReadFile((d.out / f.name).string()), kPrevious);
  }
}

}  // namespace
}  // namespace molvar
