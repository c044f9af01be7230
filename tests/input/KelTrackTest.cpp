#include "input/KelTrack.h"

#include <gtest/gtest.h>

#include <string>

#include "support/TestProgram.h"

namespace molvar {
namespace {

using testing::Bytes;
using testing::TestProgram;

struct KelFile : TestProgram {
  KelFile() {
    m->ProgramMode = kModeConvertTracks;
    m->TrackFileType = 8;
    m->InputName = "custom.txt";
  }
  void Read(std::string_view line) { ReadKelLine(*m, line); }
  const TrackPoint& At(int32_t i) { return m->Track.at(i); }
};

TEST(ReadKelLine, StoresTheColumns) {
  KelFile f;
  f->GmtMinutes = 120;
  f.Read("2007-03-14\t13:45:12\t45.1\t-75.2\t25\tx\tsome\tfree\ttext\there\tand\tmore\tignored");
  ASSERT_EQ(f->Track.PointCount, 1);
  const TrackPoint& p = f.At(1);
  EXPECT_EQ(p.DateTime, "2007-03-14 13:45:12");  // as written, no GMT offset
  EXPECT_DOUBLE_EQ(p.Latitude, 45.1);
  EXPECT_DOUBLE_EQ(p.Longitude, -75.2);
  EXPECT_EQ(p.PointText, "some free text here and more");
  EXPECT_EQ(p.Flag, 1);
  EXPECT_EQ(p.Altitude, 0);
  EXPECT_DOUBLE_EQ(p.Speed, 0);  // point 1 never has a speed

  f.Read("2007-03-14\t13:46:12\t45.11\t-75.2\t25\tx\tnext");
  ASSERT_EQ(f->Track.PointCount, 2);
  const TrackPoint& q = f.At(2);
  EXPECT_DOUBLE_EQ(q.Speed, 40.2336);  // from the file, not from the 67 km/h of the positions
  EXPECT_NEAR(q.Distance, 1.1119892, 1e-9);
  EXPECT_EQ(q.Flag, 0);
  EXPECT_EQ(q.PointText, "next     ");  // empty columns 8 to 12 leave their blanks
  EXPECT_TRUE(f.platform.Messages().empty());
}

TEST(ReadKelLine, BlanksAndTabsSeparateButABlankAfterATabDoesNot) {
  KelFile f;
  f.Read("2007-03-14 13:45:12 45.1 -75.2 25 x a b c d e f g");
  EXPECT_EQ(f.At(1).DateTime, "2007-03-14 13:45:12");
  EXPECT_DOUBLE_EQ(f.At(1).Latitude, 45.1);
  EXPECT_EQ(f.At(1).PointText, "a b c d e f");

  f.Read("2007-03-14\t 13:45:13\t\t45.1\t-75.2\t  10\tx\ta \tb");
  EXPECT_EQ(f.At(2).DateTime, "2007-03-14 13:45:13");
  EXPECT_DOUBLE_EQ(f.At(2).Latitude, 45.1);
  EXPECT_DOUBLE_EQ(f.At(2).Longitude, -75.2);
  // "\t  10": the first blank joins the TAB, the second opens an empty speed column.
  EXPECT_DOUBLE_EQ(f.At(2).Speed, 0);
  EXPECT_EQ(f.At(2).PointText, "x a  b  ");

  f.Read("2007-03-14 13:45:14  45.1 -75.2");  // two blanks: an empty latitude column
  EXPECT_EQ(f.At(3).DateTime, "2007-03-14 13:45:14");
  EXPECT_DOUBLE_EQ(f.At(3).Latitude, 0);
  EXPECT_DOUBLE_EQ(f.At(3).Longitude, 45.1);
  EXPECT_DOUBLE_EQ(f.At(3).Speed, -75 * 1.609344);  // the longitude, read as whole miles per hour
  EXPECT_TRUE(f.platform.Messages().empty());
}

TEST(ReadKelLine, SpeedIsWholeMilesPerHour) {
  KelFile f;
  f.Read("2007-03-14\t12:00:00\t45.00\t-75\t10");
  f.Read("2007-03-14\t12:01:00\t45.01\t-75\t25.5");  // 26 mph
  f.Read("2007-03-14\t12:02:00\t45.02\t-75\t24.5");  // 24 mph
  f.Read("2007-03-14\t12:03:00\t45.03\t-75");        // no speed: from distance and time
  f.Read("2007-03-14\t12:04:00\t45.04\t-75\t0");     // 0 mph: from distance and time too
  f.Read("2007-03-14\t12:05:00\t45.05\t-75\t1e300");  // out of range reads as 0
  ASSERT_EQ(f->Track.PointCount, 6);
  EXPECT_DOUBLE_EQ(f.At(2).Speed, 26 * 1.609344);
  EXPECT_DOUBLE_EQ(f.At(3).Speed, 24 * 1.609344);
  EXPECT_DOUBLE_EQ(f.At(4).Speed, 67);
  EXPECT_DOUBLE_EQ(f.At(5).Speed, 67);
  EXPECT_DOUBLE_EQ(f.At(6).Speed, 67);
  EXPECT_TRUE(f.platform.Messages().empty());
}

TEST(ReadKelLine, ThreeDashesMeanNoFix) {
  KelFile f;
  f.Read("2007-03-14\t13:45:12\t45.1\t-75.2\t10");
  f.Read("2007-03-14\t13:40:00\t45.1\t-75.2\t---");   // no point, and no time check
  f.Read("2007-03-14\t13:40:00\t---\t---\t10");
  f.Read("2007-03-14\t13:40:00\t45.1\t-75.2\t10\tx\t---------");
  f.Read("2007-03-14 13:40:00 45.1 -75.2 10 x a b c d e f g h i ---");  // column 16
  EXPECT_EQ(f->Track.PointCount, 1);
  EXPECT_EQ(f->Track.Bound(), 1);
  EXPECT_TRUE(f.platform.Messages().empty());

  f.Read("2007-03-14\t13:46:00\t45.1\t-75.2\t10\tx\tlow--- -- -");
  ASSERT_EQ(f->Track.PointCount, 2);
  EXPECT_EQ(f.At(2).PointText, "low--- -- -   ");
}

TEST(ReadKelLine, OutOfSequenceTimeWarnsOncePerFile) {
  KelFile f;
  f.Read("2007-03-14\t13:45:12\t45.1\t-75.2\t10");
  f.Read("2007-03-14\t13:46:12\t45.1\t-75.2\t10");
  f.Read("2007-03-14\t13:46:12\t45.1\t-75.2\t10");
  EXPECT_TRUE(f.platform.Messages().empty());
  f.Read("2007-03-14\t13:46:11\t45.1\t-75.2\t10");
  f.Read("2007-03-13\t13:46:11\t45.1\t-75.2\t10");
  EXPECT_EQ(f->Track.PointCount, 5);
  auto messages = f.platform.Messages();
  ASSERT_EQ(messages.size(), 1u);
  EXPECT_EQ(messages[0].text,
            "Timestamp out of sequence (near line 3) in file custom.txt. \r\n"
            "Please check your input file for this, and possibly other, errors.\r\n"
            "Consider deleting the bad line and loading the file again.");
  EXPECT_EQ(messages[0].title, " Bad timestamp in input file");
  EXPECT_EQ(messages[0].icon, MsgIcon::Exclamation);

  f->Track.PointCount = 0;  // next file
  f.Read("2007-03-14\t13:45:12\t45.1\t-75.2\t10");
  f.Read("2007-03-14\t13:45:11\t45.1\t-75.2\t10");
  messages = f.platform.Messages();
  ASSERT_EQ(messages.size(), 2u);
  EXPECT_EQ(messages[1].text.substr(0, 42), "Timestamp out of sequence (near line 1) in");
}

TEST(ReadKelLine, BadLinesAddWhatTheirColumnsSay) {
  KelFile f;
  f.Read("");
  EXPECT_EQ(f->Track.PointCount, 0);
  EXPECT_EQ(f->Track.Bound(), 0);

  f.Read("garbage");
  ASSERT_EQ(f->Track.PointCount, 1);
  EXPECT_EQ(f.At(1).DateTime, "garbage ");
  EXPECT_DOUBLE_EQ(f.At(1).Latitude, 0);
  EXPECT_DOUBLE_EQ(f.At(1).Longitude, 0);
  EXPECT_DOUBLE_EQ(f.At(1).Speed, 0);
  EXPECT_EQ(f.At(1).PointText, "     ");

  f.Read(Bytes("\x00\x01\t\xff\xfe\t\x80\t\x1b[2J\t\xc3\xa9"));
  ASSERT_EQ(f->Track.PointCount, 2);
  EXPECT_DOUBLE_EQ(f.At(2).Latitude, 0);
  EXPECT_DOUBLE_EQ(f.At(2).Longitude, 0);
  EXPECT_DOUBLE_EQ(f.At(2).Speed, 0);

  std::string huge = "2007-03-14\t13:45:12\t45.1\t-75.2\t10\tx\t";
  huge.append(1 << 20, 'w');
  f.Read(huge);
  ASSERT_EQ(f->Track.PointCount, 3);
  EXPECT_DOUBLE_EQ(f.At(3).Latitude, 45.1);
  EXPECT_EQ(f.At(3).PointText.size(), (1u << 20) + 5);

  f.Read(std::string(1 << 20, '\t'));  // every TAB after the first joins it
  ASSERT_EQ(f->Track.PointCount, 4);
  EXPECT_EQ(f.At(4).DateTime, " ");
  EXPECT_TRUE(f.platform.Messages().empty());
}

}  // namespace
}  // namespace molvar
