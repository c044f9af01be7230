// molvar-convert end to end: every input type into every output format, exit codes, messages,
// options by control name, and the settings file left as it was.
#include <gtest/gtest.h>

#include <filesystem>

#include "app/Settings.h"
#include "core/Text.h"
#include "support/Peers.h"
#include "support/TestProgram.h"

namespace molvar {
namespace {

using testing::ExpectInOrder;
using testing::ReadFile;
using testing::RunCommand;
using testing::TempFolder;
using testing::WriteFile;

struct Outcome {
  int status = -1;
  std::string out, err;
};

std::string Quote(const std::string& s) { return "'" + Replace(s, "'", "'\\''") + "'"; }

std::string Sample(const std::string& name) { return std::string(MOLVAR_SOURCE_DIR) + "/resources/Samples/" + name; }

struct Converter {
  TempFolder folder;
  Outcome operator()(const std::string& arguments) {
    Outcome r;
    const std::string out = folder.File("stdout.txt"), err = folder.File("stderr.txt");
    RunCommand(std::string(MOLVAR_CONVERT_EXE) + " --folder " + Quote(folder.path().string()) + " " + arguments +
                   " >" + Quote(out) + " 2>" + Quote(err),
               &r.status);
    r.status = WIFEXITED(r.status) ? WEXITSTATUS(r.status) : -1;
    r.out = ReadFile(out);
    r.err = ReadFile(err);
    return r;
  }
  std::string File(const std::string& name) const { return folder.File(name); }
};

// gpsbabel's reading of a file we wrote, as CSV lines.
std::string Babel(const std::string& format, const std::string& path, bool tracks = true) {
  return RunCommand(std::string("gpsbabel ") + (tracks ? "-t " : "") + "-i " + format + " -f " + Quote(path) + " -o unicsv,utc=0 -F - 2>&1");
}

struct TypeCase {
  const char* type;
  const char* sample;
  int points;
};

const TypeCase kTracks[] = {
    {"ozi", "sample.plt", 6},         {"gpx", "sample.gpx", 6},        {"xml", "sample.xml", 6},
    {"nmea", "sample-nmea.txt", 12},  {"csv1", "sample-orion.csv", 6}, {"csv2", "sample-csv2.csv", 6},
    {"kml", "sample.kml", 6},         {"aprs", "sample-aprs.txt", 6},  {"kel", "sample-kel.txt", 6},
};

TEST(MolvarConvert, EveryTrackTypeIntoEveryFormat) {
  for (const auto& c : kTracks) {
    for (const std::string ext : {"kml", "gpx", "plt"}) {
      Converter convert;
      const std::string out = convert.File(std::string("out.") + ext);
      const Outcome r = convert(std::string("--type ") + c.type + " " + Quote(Sample(c.sample)) + " " + Quote(out));
      const std::string what = std::string(c.type) + " -> " + ext + ": " + r.err;
      if (std::string(c.type) == "gpx" && ext == "gpx") {
        EXPECT_EQ(r.status, 2) << what;
        EXPECT_EQ(r.err, " Error!...: You cannot write an output GPX track file when the input file is GPX.\n");
        EXPECT_FALSE(std::filesystem::exists(out));
        continue;
      }
      ASSERT_EQ(r.status, 0) << what;
      if (ext == "kml") {
        EXPECT_EQ(r.out, " Processed " + std::to_string(c.points) + " trackpoints. (1 segments) Output: out.kml\n")
            << what;
      } else {
        EXPECT_EQ(r.out, " Output: out." + ext + "\n") << what;
      }
      // The first and the last sample point come back in order (APRS positions are in minutes to
      // two decimals, so they are compared to three decimals).
      const std::string babel = Babel(ext == "plt" ? "ozi" : ext, out);
      ExpectInOrder(babel, {"45.42", "-75.69", "45.43", "-75.68"});
    }
  }
}

TEST(MolvarConvert, WaypointTypes) {
  struct Case {
    const char* type;
    const char* sample;
    const char* ext;
    int status;
    const char* out;
  };
  const Case cases[] = {
      {"ozi-wpt", "sample.wpt", "kml", 0, " Created 6 placemarks. Output: out.kml\n"},
      {"ozi-wpt", "sample.wpt", "gpx", 0, " Output: out.gpx\n"},
      {"ozi-wpt", "sample.wpt", "wpt", 2, "\n"},
      {"gpx-wpt", "sample-waypoints.gpx", "kml", 0, " Created 6 placemarks. Output: out.kml\n"},
      {"gpx-wpt", "sample-waypoints.gpx", "gpx", 2, "\n"},
      {"gpx-wpt", "sample-waypoints.gpx", "plt", 0, " Created 6 waypoints. Output: out.plt\n"},
  };
  for (const auto& c : cases) {
    Converter convert;
    const std::string out = convert.File(std::string("out.") + c.ext);
    const Outcome r = convert(std::string("--type ") + c.type + " " + Quote(Sample(c.sample)) + " " + Quote(out));
    EXPECT_EQ(r.status, c.status) << c.type << " -> " << c.ext << ": " << r.err;
    EXPECT_EQ(r.out, c.out) << c.type << " -> " << c.ext;
    if (c.status != 0) {
      EXPECT_TRUE(StartsWith(r.err, " Error!...: You cannot write an output ")) << r.err;
      EXPECT_FALSE(std::filesystem::exists(out));
      continue;
    }
    const std::string babel = Babel(std::string(c.ext) == "plt" ? "ozi" : c.ext, out, false);
    ExpectInOrder(babel, {"45.421500,-75.697200", "45.430100,-75.684000"});
  }
}

TEST(MolvarConvert, TypeFollowsTheExtension) {
  Converter convert;
  const Outcome r = convert(Quote(Sample("sample.wpt")) + " " + Quote(convert.File("w.kml")));
  EXPECT_EQ(r.status, 0) << r.err;
  EXPECT_EQ(r.out, " Created 6 placemarks. Output: w.kml\n");
  const Outcome x = convert(Quote(Sample("sample.xml")) + " " + Quote(convert.File("x.gpx")));
  EXPECT_EQ(x.status, 0) << x.err;
  EXPECT_EQ(x.out, " Output: x.gpx\n");
}

TEST(MolvarConvert, UsageErrors) {
  Converter convert;
  const std::string in = Quote(Sample("sample.plt"));
  const std::string out = Quote(convert.File("o.kml"));
  struct Case {
    std::string args;
    std::string mentions;
  };
  const Case cases[] = {
      {"", "INPUT and OUTPUT are needed"},
      {in, "INPUT and OUTPUT are needed"},
      {in + " " + out + " extra", "only one INPUT"},
      {"--bogus " + in + " " + out, "unknown option --bogus"},
      {"--type pdf " + in + " " + out, "unknown type pdf"},
      {"--set chkNothing=1 " + in + " " + out, "unknown control chkNothing"},
      {"--set chkDetailed=2 " + in + " " + out, "bad value \"2\" for chkDetailed"},
      {"--set comboAltitude=9 " + in + " " + out, "bad value \"9\" for comboAltitude"},
      {"--set sldrWidth=0 " + in + " " + out, "bad value \"0\" for sldrWidth"},
      {"--set chkSplitColor=1 " + in + " " + out, "chkSplitColor is a control array"},
      {"--set cmdOpen=1 " + in + " " + out, "cmdOpen is not an option"},
      {"--set noequals " + in + " " + out, "bad option noequals"},
      {"--set", "--set needs a value"},
  };
  for (const auto& c : cases) {
    const Outcome r = convert(c.args);
    EXPECT_EQ(r.status, 1) << c.args;
    EXPECT_NE(r.err.find(c.mentions), std::string::npos) << c.args << ": " << r.err;
    EXPECT_NE(r.err.find("Try 'molvar-convert --help'."), std::string::npos);
    EXPECT_FALSE(std::filesystem::exists(convert.File("o.kml"))) << c.args;
  }
  const Outcome help = convert("--help");
  EXPECT_EQ(help.status, 0);
  EXPECT_TRUE(StartsWith(help.out,
                         "Usage: molvar-convert [--folder DIR] [--type NAME] [--set CONTROL=VALUE]... INPUT OUTPUT\n"));
}

TEST(MolvarConvert, NothingWritten) {
  Converter convert;
  const Outcome missing = convert(Quote(convert.File("nowhere.plt")) + " " + Quote(convert.File("o.kml")));
  EXPECT_EQ(missing.status, 2);
  EXPECT_TRUE(StartsWith(missing.err, " Whoa! An error!: ReadTrackFile snag ")) << missing.err;

  WriteFile(convert.File("empty.plt"), "h1\r\nh2\r\nh3\r\nh4\r\nh5\r\nh6\r\n");
  const Outcome empty = convert(Quote(convert.File("empty.plt")) + " " + Quote(convert.File("o.kml")));
  EXPECT_EQ(empty.status, 2);
  EXPECT_EQ(empty.out, " No track data found - no file saved.\n");
  EXPECT_FALSE(std::filesystem::exists(convert.File("o.kml")));
}

TEST(MolvarConvert, OptionsByControlName) {
  Converter convert;
  const std::string in = Quote(Sample("sample.plt"));
  const Outcome plain = convert(in + " " + Quote(convert.File("plain.kml")));
  ASSERT_EQ(plain.status, 0) << plain.err;
  const std::string plainKml = ReadFile(convert.File("plain.kml"));
  EXPECT_NE(plainKml.find("Beginning of detailed data"), std::string::npos);
  EXPECT_NE(plainKml.find(" kph"), std::string::npos);

  const Outcome set = convert("--set chkDetailed=0 --set chkUseFilename=0 --set 'txtTitle=Lake & run' "
                          "--set mnuUnitsItem=1 --set 'chkSplitColor(2)=1' --set comboAltitude=1 " +
                          in + " " + Quote(convert.File("set.kml")));
  ASSERT_EQ(set.status, 0) << set.err;
  const std::string kml = ReadFile(convert.File("set.kml"));
  EXPECT_EQ(kml.find("Beginning of detailed data"), std::string::npos);
  EXPECT_NE(kml.find("<name>Lake &amp; run</name>"), std::string::npos);
  EXPECT_NE(kml.find(" mph"), std::string::npos);
  EXPECT_NE(kml.find("SpeedLegend.jpg"), std::string::npos) << "vary by speed draws the legend";
  EXPECT_NE(kml.find("<altitudeMode>absolute</altitudeMode>"), std::string::npos);
  EXPECT_TRUE(std::filesystem::exists(convert.File("SpeedLegend.jpg"))) << "resources are installed";
  EXPECT_TRUE(std::filesystem::exists(convert.File("Icons/0.png")));
}

TEST(MolvarConvert, ReadsTheSettingsFileAndNeverWritesIt) {
  Converter convert;
  {
    testing::TestProgram t;
    t->ProgramFolder = convert.folder.path().string();
    t->frmMain.chkDetailed.Value = 0;
    t->frmMain.txtGMT.Text = "-5";
    ASSERT_TRUE(SaveSettings(*t));
  }
  const std::string ini = ReadFile(convert.File("Molvar.ini"));
  const Outcome r = convert(Quote(Sample("sample.gpx")) + " " + Quote(convert.File("s.kml")));
  ASSERT_EQ(r.status, 0) << r.err;
  EXPECT_EQ(ReadFile(convert.File("Molvar.ini")), ini);
  EXPECT_FALSE(std::filesystem::exists(convert.File("TrackData.txt")));
  EXPECT_FALSE(std::filesystem::exists(convert.File("agwpe.txt")));
  // From the settings: no details, and GMT -5, so 13:45:12 UTC starts the track at 08:45:12 local.
  const std::string kml = ReadFile(convert.File("s.kml"));
  EXPECT_EQ(kml.find("Beginning of detailed data"), std::string::npos);
  EXPECT_NE(kml.find("Start  08:45:12 AM"), std::string::npos) << kml;
}

}  // namespace
}  // namespace molvar
