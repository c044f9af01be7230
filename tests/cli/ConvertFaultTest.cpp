// molvar-convert with its files failing underneath it, through a preloaded shim
// (tests/reliability/FaultShim.c): a disk that fills at any byte of the output, a close that
// reports the full disk late, a folder that refuses new files even to root, and an input cut short
// by another program while it is read. Every failure exits with 2 and one message naming the file
// and the reason; the previous output stays byte for byte and no temporary file is left.
#include <gtest/gtest.h>

#include <cstdio>
#include <filesystem>

#include "core/Text.h"
#include "support/Faults.h"
#include "support/Peers.h"
#include "support/TestProgram.h"

namespace molvar {
namespace {

namespace fs = std::filesystem;
using testing::CutPoints;
using testing::NamesIn;
using testing::ReadFile;
using testing::RunCommand;
using testing::TempFolder;
using testing::WriteFile;

constexpr const char* kPrevious = "the previous output\r\n";

std::string Quote(const std::string& s) { return "'" + Replace(s, "'", "'\\''") + "'"; }
std::string Sample(const std::string& name) { return std::string(MOLVAR_SOURCE_DIR) + "/resources/Samples/" + name; }

struct Outcome {
  int status = -1;
  std::string out, err;
};

// A program folder, and beside it the folder of the outputs, the one the shim acts on.
struct FaultyConverter {
  TempFolder folder;
  fs::path out = fs::canonical(folder.path()) / "out";
  FaultyConverter() { fs::create_directory(out); }

  // `faults`: the shim's variables as "NAME=value ..." (empty: the shim is loaded but idle).
  Outcome operator()(const std::string& faults, const std::string& arguments) {
    Outcome r;
    const std::string o = folder.File("stdout.txt"), e = folder.File("stderr.txt");
    // A sanitized executable wants its runtime first in the library list; the shim goes first.
    const std::string command =
        "MOLVAR_FAULT_DIR=" + Quote(out.string()) + " " + faults + " LD_PRELOAD=" + Quote(MOLVAR_FAULT_SHIM) +
        " ASAN_OPTIONS=\"${ASAN_OPTIONS:+$ASAN_OPTIONS:}verify_asan_link_order=0\" " + MOLVAR_CONVERT_EXE +
        " --folder " + Quote(folder.path().string()) + " " + arguments + " >" + Quote(o) + " 2>" + Quote(e);
    RunCommand(command, &r.status);
    r.status = WIFEXITED(r.status) ? WEXITSTATUS(r.status) : -1;
    r.out = ReadFile(o);
    r.err = ReadFile(e);
    return r;
  }
  Outcome Convert(const std::string& faults, const std::string& input, const std::string& name) {
    return (*this)(faults, Quote(input) + " " + Quote((out / name).string()));
  }
  std::string Target(const std::string& name) const { return (out / name).string(); }
};

struct Format {
  const char* name;
  const char* failing;  // the procedure that reports the failed write
};
const Format kFormats[] = {{"t.kml", "WriteKmlFooter"}, {"t.gpx", "WriteOutputFile"}, {"t.plt", "WriteOutputFile"}};

void ExpectNothingWritten(const FaultyConverter& c, const Outcome& r, const std::string& name,
                          const std::string& message, const std::string& what) {
  EXPECT_EQ(r.status, 2) << what;
  EXPECT_EQ(r.err, message + "\n") << what;
  EXPECT_FALSE(Contains(r.out, "Output:")) << what << ": " << r.out;
  EXPECT_EQ(ReadFile(c.Target(name)), kPrevious) << what;
  EXPECT_EQ(NamesIn(c.out), std::vector<std::string>{name}) << what << ": no temporary file stays";
}

TEST(ConvertFault, DiskFullAtEveryByteStageOfEachFormat) {
  for (const Format& f : kFormats) {
    FaultyConverter c;
    const Outcome first = c.Convert("", Sample("sample.plt"), f.name);
    ASSERT_EQ(first.status, 0) << first.err;
    const std::string complete = ReadFile(c.Target(f.name));
    const std::string full = "Error: " + std::string(f.failing) + " bug Disk full (" + c.Target(f.name) +
                             ": No space left on device)";
    for (const std::size_t cut : CutPoints(complete.size())) {
      WriteFile(c.Target(f.name), kPrevious);
      const Outcome r =
          c.Convert("MOLVAR_FAULT_WRITE_BUDGET=" + std::to_string(cut), Sample("sample.plt"), f.name);
      ExpectNothingWritten(c, r, f.name, full, std::string(f.name) + " cut at " + std::to_string(cut));
    }
    // A file system that accepts every byte and reports the full disk only when the file closes.
    WriteFile(c.Target(f.name), kPrevious);
    ExpectNothingWritten(c, c.Convert("MOLVAR_FAULT_CLOSE_ENOSPC=1", Sample("sample.plt"), f.name), f.name,
                         full, std::string(f.name) + " at its close");
    // Room again.
    const Outcome again = c.Convert("", Sample("sample.plt"), f.name);
    EXPECT_EQ(again.status, 0) << again.err;
    EXPECT_EQ(ReadFile(c.Target(f.name)), complete);
  }
}

// Waypoint output goes through the same file; its failures are reported by the waypoint reader,
// which owns the file from head to tail, except the KML tail's own.
TEST(ConvertFault, DiskFullUnderWaypointOutput) {
  struct Case {
    const char* input;
    const char* name;
    const char* message;
  };
  const Case cases[] = {
      {"sample.wpt", "w.kml", "Error: WriteKmlFooter bug"},
      {"sample.wpt", "w.gpx", " Whoa! An error!: ReadWaypointFile snag"},
      {"sample-waypoints.gpx", "w.plt", " Whoa! An error!: ReadWaypointFile snag"},
  };
  for (const Case& k : cases) {
    FaultyConverter c;
    const std::string type = std::string(k.input) == "sample.wpt" ? "ozi-wpt" : "gpx-wpt";
    const std::string arguments = "--type " + type + " " + Quote(Sample(k.input)) + " " + Quote(c.Target(k.name));
    const Outcome first = c("", arguments);
    ASSERT_EQ(first.status, 0) << first.err;
    const std::string complete = ReadFile(c.Target(k.name));
    for (const std::size_t cut : {std::size_t{0}, complete.size() / 2, complete.size() - 1}) {
      WriteFile(c.Target(k.name), kPrevious);
      ExpectNothingWritten(c, c("MOLVAR_FAULT_WRITE_BUDGET=" + std::to_string(cut), arguments), k.name,
                           std::string(k.message) + " Disk full (" + c.Target(k.name) + ": No space left on device)",
                           std::string(k.name) + " cut at " + std::to_string(cut));
    }
    EXPECT_EQ(c("", arguments).status, 0);
    EXPECT_EQ(ReadFile(c.Target(k.name)), complete);
  }
}

// The shim refuses new files in the folder to root as well; without root, the folder's mode does
// the same for real.
TEST(ConvertFault, OutputFolderThatTakesNoNewFile) {
  for (const Format& f : kFormats) {
    FaultyConverter c;
    WriteFile(c.Target(f.name), kPrevious);
    const std::string head = std::string(f.name) == "t.kml" ? "WriteKmlHeader" : "WriteOutputFile";
    const std::string denied =
        "Error: " + head + " bug Permission denied (" + c.Target(f.name) + ": Permission denied)";
    ExpectNothingWritten(c, c.Convert("MOLVAR_FAULT_DENY_CREATE=1", Sample("sample.plt"), f.name), f.name, denied,
                         std::string(f.name) + " refused by the shim");
    if (!testing::RunningAsRoot()) {
      Outcome r;
      {
        testing::ReadOnlyFolder readOnly(c.out);
        r = c.Convert("", Sample("sample.plt"), f.name);
      }
      ExpectNothingWritten(c, r, f.name, denied, std::string(f.name) + " in a read-only folder");
    }
    const Outcome again = c.Convert("", Sample("sample.plt"), f.name);
    EXPECT_EQ(again.status, 0) << again.err;
    EXPECT_NE(ReadFile(c.Target(f.name)), kPrevious);
  }
}

// A PLT file larger than one read, cut by another program right after the first read (1 MiB):
// the track holds the points of the lines that were there and none from beyond the cut. A line cut
// in its middle is the file's last line, without a line end, and reads as far as it goes: here all
// but its time text, which the reader does not use, are there.
TEST(ConvertFault, InputCutWhileItIsRead) {
  FaultyConverter c;
  const std::string in = c.folder.File("long.plt");
  std::string plt =
      "OziExplorer Track Point File Version 2.1\r\nWGS 84\r\nAltitude is in Feet\r\nReserved 3\r\n"
      "0,2,255,Track,0,0,2,8421376\r\n20000\r\n";
  std::vector<std::size_t> lineEnds;
  for (int i = 0; i < 20000; ++i) {
    char line[96];
    std::snprintf(line, sizeof line, "45.%06d,-75.000000,0,328,%.8f,14-Mar-07,12:00:00\r\n", i, 39155.5 + i / 86400.0);
    plt += line;
    lineEnds.push_back(plt.size());
  }
  ASSERT_GT(lineEnds[18004], std::size_t{1} << 20) << "the cut falls after the first read";
  struct Case {
    std::size_t cutTo;
    int points;
  };
  // At a line end (18005 whole point lines stay), and after the day number of the next line.
  const Case cases[] = {{lineEnds[18004], 18005}, {lineEnds[18004] + 41, 18006}};
  for (const Case& k : cases) {
    WriteFile(in, plt);
    WriteFile(c.Target("t.kml"), kPrevious);
    const Outcome r = c("MOLVAR_FAULT_TRUNCATE_PATH=" + Quote(in) + " MOLVAR_FAULT_TRUNCATE_TO=" +
                            std::to_string(k.cutTo),
                        "--set chkDetailed=0 " + Quote(in) + " " + Quote(c.Target("t.kml")));
    EXPECT_EQ(fs::file_size(in), k.cutTo) << "the shim cut the file";
    EXPECT_EQ(r.status, 0) << r.err;
    EXPECT_EQ(r.out, " Processed " + std::to_string(k.points) + " trackpoints. (1 segments) Output: t.kml\n");
    testing::ExpectWellFormedXml(c.Target("t.kml"));
    const std::string kml = ReadFile(c.Target("t.kml"));
    char lastRead[32], beyond[32];
    std::snprintf(lastRead, sizeof lastRead, "-75,45.%06d", k.points - 1);
    std::snprintf(beyond, sizeof beyond, "-75,45.%06d", k.points);
    EXPECT_TRUE(Contains(kml, lastRead)) << lastRead;
    EXPECT_FALSE(Contains(kml, beyond)) << "nothing from beyond the cut";
    EXPECT_EQ(NamesIn(c.out), std::vector<std::string>{"t.kml"});
  }
}

}  // namespace
}  // namespace molvar
