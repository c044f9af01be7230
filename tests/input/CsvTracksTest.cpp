#include "input/CsvTracks.h"

#include <gtest/gtest.h>

#include <string>

#include "input/KelTrack.h"
#include "support/TestProgram.h"

namespace molvar {
namespace {

using testing::Bytes;
using testing::TestProgram;

constexpr const char* kOutOfSequenceTitle = " Bad timestamp in input file";

std::string OutOfSequenceText(int line, std::string_view file) {
  return "Timestamp out of sequence (near line " + std::to_string(line) + ") in file " + std::string(file) +
         ". \r\nPlease check your input file for this, and possibly other, errors.\r\n"
         "Consider deleting the bad line and loading the file again.";
}

struct CsvFile : TestProgram {
  explicit CsvFile(int16_t type) {
    m->ProgramMode = kModeConvertTracks;
    m->TrackFileType = type;
    m->InputName = "track.csv";
  }
  const TrackPoint& At(int32_t i) { return m->Track.at(i); }
  void SplitIfStopped(bool on) { m->frmMain.chkSplitIfStopped.Value = on ? 1 : 0; }
};

struct OrionFile : CsvFile {
  OrionFile() : CsvFile(4) {}
  void Read(std::string_view line) { ReadOrionCsvLine(*m, line); }
};

struct Csv2File : CsvFile {
  Csv2File() : CsvFile(5) {}
  void Read(std::string_view line) { ReadCsv2Line(*m, line); }
};

// Type 1 columns: 2 timestamp, 5 status, 6 longitude, 7 latitude, 8 colour band, 9 speed (mph).
std::string Orion(std::string_view time, std::string_view lat = "45.1", std::string_view lon = "-75.2",
                  std::string_view speed = "10", std::string_view band = "3",
                  std::string_view status = "STOPPED") {
  return "17," + std::string(time) + ",x,y," + std::string(status) + "," + std::string(lon) + "," +
         std::string(lat) + "," + std::string(band) + "," + std::string(speed);
}

TEST(ReadOrionCsvLine, StoresTheColumns) {
  OrionFile f;
  f.Read("17,2007-03-14 13:45:12 EST,x,y,STOPPED,-75.2,45.1,3,25");
  ASSERT_EQ(f->Track.PointCount, 1);
  const TrackPoint& p = f.At(1);
  EXPECT_DOUBLE_EQ(p.Latitude, 45.1);
  EXPECT_DOUBLE_EQ(p.Longitude, -75.2);
  EXPECT_EQ(p.DateTime, "2007-03-14 13:45:12 EST");  // as written
  EXPECT_DOUBLE_EQ(p.Speed, 0);                       // point 1 never has a speed
  EXPECT_EQ(p.ColorBand, 3);
  EXPECT_EQ(p.Flag, 1);
  EXPECT_EQ(p.Altitude, 0);
  EXPECT_DOUBLE_EQ(p.Distance, 0);

  f.Read("18,2007-03-14 13:46:12 EST,x,y,STOPPED,-75.2,45.11,9,25");
  ASSERT_EQ(f->Track.PointCount, 2);
  const TrackPoint& q = f.At(2);
  EXPECT_DOUBLE_EQ(q.Latitude, 45.11);
  EXPECT_DOUBLE_EQ(q.Speed, 40.2336);
  EXPECT_EQ(q.ColorBand, 9);
  EXPECT_EQ(q.Flag, 0);
  EXPECT_NEAR(q.Distance, 1.1119892, 1e-9);
  EXPECT_TRUE(f.platform.Messages().empty());
}

TEST(ReadOrionCsvLine, FieldsAreTrimmedAndNoGmtOffsetApplies) {
  OrionFile f;
  f->GmtMinutes = -300;
  f.Read(Orion("2007-03-14 13:45:00 EST"));
  f.Read("17, 2007-03-14 13:45:12 EST ,x,y, STOPPED , -75.2 , 45.1 , 3 , 25 ");
  const TrackPoint& p = f.At(2);
  EXPECT_DOUBLE_EQ(p.Latitude, 45.1);
  EXPECT_DOUBLE_EQ(p.Longitude, -75.2);
  EXPECT_EQ(p.DateTime, "2007-03-14 13:45:12 EST");
  EXPECT_DOUBLE_EQ(p.Speed, 40.2336);
  EXPECT_EQ(p.ColorBand, 3);
}

TEST(ReadOrionCsvLine, MotionDetectedStartsASegmentWhenSplittingIfStopped) {
  OrionFile f;
  f.Read(Orion("2007-03-14 13:45:12 EST"));
  f.Read(Orion("2007-03-14 13:45:22 EST", "45.1", "-75.2", "10", "3", "MOTION DETECTED"));
  EXPECT_EQ(f.At(2).Flag, 0);  // option off
  f.SplitIfStopped(true);
  f.Read(Orion("2007-03-14 13:45:32 EST", "45.1", "-75.2", "10", "3", " MOTION DETECTED "));
  f.Read(Orion("2007-03-14 13:45:42 EST", "45.1", "-75.2", "10", "3", "motion detected"));
  f.Read(Orion("2007-03-14 13:45:52 EST", "45.1", "-75.2", "10", "3", "MOVING"));
  EXPECT_EQ(f.At(3).Flag, 1);
  EXPECT_EQ(f.At(4).Flag, 0);
  EXPECT_EQ(f.At(5).Flag, 0);
}

TEST(ReadOrionCsvLine, SpeedComesOnlyFromTheFile) {
  OrionFile f;
  f.Read(Orion("2007-03-14 12:00:00 EST", "45.00", "-75", ""));
  f.Read(Orion("2007-03-14 12:01:00 EST", "45.01", "-75", ""));  // 67 km/h by position and time
  f.Read(Orion("2007-03-14 12:02:00 EST", "45.02", "-75", "0"));
  f.Read(Orion("2007-03-14 12:03:00 EST", "45.03", "-75", " 1.5"));
  ASSERT_EQ(f->Track.PointCount, 4);
  EXPECT_DOUBLE_EQ(f.At(2).Speed, 0);
  EXPECT_NEAR(f.At(2).Distance, 1.1119892, 1e-9);
  EXPECT_DOUBLE_EQ(f.At(3).Speed, 0);
  EXPECT_NEAR(f.At(3).Distance, 2.2239784, 1e-9);
  EXPECT_DOUBLE_EQ(f.At(4).Speed, 1.5 * 1.609344);
}

TEST(ReadOrionCsvLine, ColourBandIsAWholeNumberFrom0To9) {
  OrionFile f;
  const char* bands[] = {"9", "10", "-1", "4.5", "5.5", "", "x", " 7", "1e10"};
  const int16_t expected[] = {9, 0, 0, 4, 6, 0, 0, 7, 0};
  for (const char* b : bands) f.Read(Orion("2007-03-14 13:45:12 EST", "45.1", "-75.2", "10", b));
  ASSERT_EQ(f->Track.PointCount, 9);
  for (int i = 0; i < 9; ++i) EXPECT_EQ(f.At(i + 1).ColorBand, expected[i]) << "band text " << bands[i];
}

TEST(ReadOrionCsvLine, OutOfSequenceTimeWarnsOnceAndKeepsTheLine) {
  OrionFile f;
  f.Read(Orion("2007-03-14 13:45:12 EST"));
  f.Read(Orion("2007-03-14 13:46:12 EST"));
  f.Read(Orion("2007-03-14 13:46:12 EST"));  // equal is in sequence
  EXPECT_TRUE(f.platform.Messages().empty());
  f.Read(Orion("2007-03-14 13:45:30 EST"));
  f.Read(Orion("2007-03-14 13:40:00 EST"));
  f.Read(Orion("2007-03-13 13:40:00 EST"));
  ASSERT_EQ(f->Track.PointCount, 6);
  EXPECT_EQ(f.At(4).DateTime, "2007-03-14 13:45:30 EST");
  const auto messages = f.platform.Messages();
  ASSERT_EQ(messages.size(), 1u);
  EXPECT_EQ(messages[0].text, OutOfSequenceText(3, "track.csv"));
  EXPECT_EQ(messages[0].title, kOutOfSequenceTitle);
  EXPECT_EQ(messages[0].icon, MsgIcon::Exclamation);
  EXPECT_EQ(messages[0].buttons, MsgButtons::OK);
}

TEST(ReadOrionCsvLine, ThirdLineEarlierThanSecondNamesLine2) {
  OrionFile f;
  f.Read(Orion("2007-03-14 13:45:12 EST"));
  f.Read(Orion("2007-03-14 13:46:12 EST"));
  f.Read(Orion("2007-03-14 13:45:13 EST"));
  EXPECT_EQ(f->Track.PointCount, 3);
  const auto messages = f.platform.Messages();
  ASSERT_EQ(messages.size(), 1u);
  EXPECT_EQ(messages[0].text, OutOfSequenceText(2, "track.csv"));
}

TEST(ReadOrionCsvLine, TimesAreComparedWithoutTheirLastFourCharacters) {
  OrionFile f;
  // Only without " EST" do these read as times.
  f.Read(Orion("2007-03-14 13:45:12 EST"));
  f.Read(Orion("2007-03-14 13:45:11 EST"));
  ASSERT_EQ(f.platform.Messages().size(), 1u);

  OrionFile g;
  g.Read(Orion("2007-03-14 13:45:12.250"));
  g.Read(Orion("2007-03-14 13:45:12.100"));  // same second once cut
  g.Read(Orion("2007-03-14 13:45:1"));      // "2007-03-14 13:" is no time: no evidence of disorder
  EXPECT_TRUE(g.platform.Messages().empty());
  EXPECT_EQ(g->Track.PointCount, 3);
}

TEST(ReadOrionCsvLine, EachFileMayWarnOnce) {
  OrionFile f;
  f.Read(Orion("2007-03-14 13:45:12 EST"));
  f.Read(Orion("2007-03-14 13:45:00 EST"));
  f->Track.PointCount = 0;  // the driver starts the next file
  f.Read(Orion("2007-03-14 13:45:12 EST"));
  f.Read(Orion("2007-03-14 13:45:00 EST"));
  f.Read(Orion("2007-03-14 13:44:00 EST"));
  const auto messages = f.platform.Messages();
  ASSERT_EQ(messages.size(), 2u);
  EXPECT_EQ(messages[1].text, OutOfSequenceText(1, "track.csv"));
}

TEST(ReadOrionCsvLine, BadLinesAddWhatTheirColumnsSay) {
  OrionFile f;
  f.Read("");
  EXPECT_EQ(f->Track.PointCount, 0);
  EXPECT_EQ(f->Track.Bound(), 0);

  f.Read(Orion("2007-03-14 13:45:12 EST"));
  f.Read("garbage");
  ASSERT_EQ(f->Track.PointCount, 2);
  EXPECT_DOUBLE_EQ(f.At(2).Latitude, 0);
  EXPECT_DOUBLE_EQ(f.At(2).Longitude, 0);
  EXPECT_TRUE(f.At(2).DateTime.empty());
  EXPECT_DOUBLE_EQ(f.At(2).Speed, 0);
  EXPECT_EQ(f.At(2).ColorBand, 0);
  EXPECT_EQ(f.At(2).Flag, 0);

  f.Read("1,2007-03-14 13:50:00 EST,x");  // missing columns
  ASSERT_EQ(f->Track.PointCount, 3);
  EXPECT_EQ(f.At(3).DateTime, "2007-03-14 13:50:00 EST");
  EXPECT_DOUBLE_EQ(f.At(3).Latitude, 0);

  f.Read(Bytes("\x01\x00,\xff\xfe\x80,\x7f,,,\xc3\xa9,\x00"));
  ASSERT_EQ(f->Track.PointCount, 4);
  EXPECT_DOUBLE_EQ(f.At(4).Latitude, 0);
  EXPECT_DOUBLE_EQ(f.At(4).Longitude, 0);

  std::string huge = Orion("2007-03-14 13:51:00 EST");
  huge.append(1 << 20, 'z');
  f.Read(huge);
  ASSERT_EQ(f->Track.PointCount, 5);
  EXPECT_DOUBLE_EQ(f.At(5).Latitude, 45.1);
  EXPECT_DOUBLE_EQ(f.At(5).Speed, 16.09344);  // the leading number of "10zzz..."
  EXPECT_TRUE(f.platform.Messages().empty());
}

TEST(ReadCsv2Line, StoresTheColumns) {
  Csv2File f;
  f->GmtMinutes = 60;
  f.Read("1,2007-03-14 13:45:12,45.1,-75.2,x,Stopped,25mph");
  ASSERT_EQ(f->Track.PointCount, 1);
  const TrackPoint& p = f.At(1);
  EXPECT_EQ(p.DateTime, "2007-03-14 13:45:12");  // date and time columns as written
  EXPECT_DOUBLE_EQ(p.Latitude, 45.1);
  EXPECT_DOUBLE_EQ(p.Longitude, -75.2);
  EXPECT_DOUBLE_EQ(p.Speed, 0);  // point 1 never has a speed
  EXPECT_EQ(p.Flag, 1);
  EXPECT_EQ(p.Altitude, 0);
  f.Read("2,2007-03-14 13:46:12,45.11,-75.2,x,Stopped,25mph");
  ASSERT_EQ(f->Track.PointCount, 2);
  EXPECT_EQ(f.At(2).DateTime, "2007-03-14 13:46:12");
  EXPECT_DOUBLE_EQ(f.At(2).Speed, 40.2336);
  EXPECT_EQ(f.At(2).Flag, 0);
  EXPECT_NEAR(f.At(2).Distance, 1.1119892, 1e-9);
  EXPECT_TRUE(f.platform.Messages().empty());
}

TEST(ReadCsv2Line, CommasAndBlanksBothSeparate) {
  Csv2File f;
  f.Read("1,2007-03-14 13:45:00,45.1,-75.2,x,Stopped,1mph");
  f.Read("1 2007-03-14,13:45:12 45.1 -75.2,x Stopped 12.5mph");
  f.Read("1,2007-03-14  13:46:12,45.1,-75.2,x,Stopped,25mph");  // two blanks: an empty column
  ASSERT_EQ(f->Track.PointCount, 3);
  EXPECT_EQ(f.At(2).DateTime, "2007-03-14 13:45:12");
  EXPECT_DOUBLE_EQ(f.At(2).Latitude, 45.1);
  EXPECT_DOUBLE_EQ(f.At(2).Longitude, -75.2);
  EXPECT_DOUBLE_EQ(f.At(2).Speed, 20.1168);
  EXPECT_EQ(f.At(3).DateTime, "2007-03-14 ");
  EXPECT_DOUBLE_EQ(f.At(3).Latitude, 13);  // "13:46:12" read as a number
  EXPECT_DOUBLE_EQ(f.At(3).Longitude, 45.1);
  EXPECT_DOUBLE_EQ(f.At(3).Speed, 0);  // "Stopped" in the speed column
  ASSERT_EQ(f.platform.Messages().size(), 1u);  // a date alone is midnight, before 13:45:12
  EXPECT_EQ(f.platform.Messages()[0].text, OutOfSequenceText(2, "track.csv"));
}

TEST(ReadCsv2Line, SpeedNeedsMph) {
  Csv2File f;
  const char* speeds[] = {"25mph", "25", "25 mph", "mph", "0mph", "7.5mph"};
  const double expected[] = {40.2336, 0, 0, 0, 0, 12.07008};
  f.Read("1,2007-03-14 13:45:12,45.1,-75.2,x,Stopped,1mph");
  for (const char* s : speeds) f.Read(std::string("1,2007-03-14 13:45:12,45.1,-75.2,x,Stopped,") + s);
  ASSERT_EQ(f->Track.PointCount, 7);
  for (int i = 0; i < 6; ++i) EXPECT_DOUBLE_EQ(f.At(i + 2).Speed, expected[i]) << speeds[i];
}

TEST(ReadCsv2Line, SpeedIsNotDerivedFromPositions) {
  Csv2File f;
  f.Read("1,2007-03-14 12:00:00,45.00,-75,x,Stopped,");
  f.Read("1,2007-03-14 12:01:00,45.01,-75,x,Stopped,");
  EXPECT_NEAR(f.At(2).Distance, 1.1119892, 1e-9);
  EXPECT_DOUBLE_EQ(f.At(2).Speed, 0);
}

TEST(ReadCsv2Line, MovingStartsASegmentWhenSplittingIfStopped) {
  Csv2File f;
  f.Read("1,2007-03-14 13:45:12,45.1,-75.2,x,Moving,25mph");
  f.Read("1,2007-03-14 13:45:13,45.1,-75.2,x,Moving,25mph");
  EXPECT_EQ(f.At(2).Flag, 0);
  f.SplitIfStopped(true);
  f.Read("1,2007-03-14 13:45:14,45.1,-75.2,x,Moving,25mph");
  f.Read("1,2007-03-14 13:45:15,45.1,-75.2,x,MOVING,25mph");
  f.Read("1,2007-03-14 13:45:16,45.1,-75.2,x,Stopped,25mph");
  EXPECT_EQ(f.At(3).Flag, 1);
  EXPECT_EQ(f.At(4).Flag, 0);
  EXPECT_EQ(f.At(5).Flag, 0);
}

TEST(ReadCsv2Line, OutOfSequenceTimeWarnsOncePerFile) {
  Csv2File f;
  f->InputName = "type2.csv";
  f.Read("1,2007-03-14 13:45:12,45.1,-75.2,x,Moving,25mph");
  f.Read("1,2007-03-14 13:46:12,45.1,-75.2,x,Moving,25mph");
  f.Read("1,2007-03-14 13:46:00,45.1,-75.2,x,Moving,25mph");
  f.Read("1,2007-03-13 13:46:00,45.1,-75.2,x,Moving,25mph");
  EXPECT_EQ(f->Track.PointCount, 4);
  auto messages = f.platform.Messages();
  ASSERT_EQ(messages.size(), 1u);
  EXPECT_EQ(messages[0].text, OutOfSequenceText(2, "type2.csv"));
  EXPECT_EQ(messages[0].title, kOutOfSequenceTitle);
  EXPECT_EQ(messages[0].icon, MsgIcon::Exclamation);

  f->Track.PointCount = 0;
  f.Read("1,2007-03-14 13:45:12,45.1,-75.2,x,Moving,25mph");
  f.Read("1,2007-03-14 13:45:11,45.1,-75.2,x,Moving,25mph");
  messages = f.platform.Messages();
  ASSERT_EQ(messages.size(), 2u);
  EXPECT_EQ(messages[1].text, OutOfSequenceText(1, "type2.csv"));
}

// Each reader keeps its own flag: a warning from one does not silence another.
TEST(ReadCsv2Line, EachReaderWarnsOnItsOwn) {
  Csv2File f;
  // Fractions of a second, so that every reader reads every other reader's times.
  ReadOrionCsvLine(*f, Orion("2007-03-14 13:45:12.000"));
  ReadOrionCsvLine(*f, Orion("2007-03-14 13:45:00.000"));
  ASSERT_EQ(f.platform.Messages().size(), 1u);
  f.Read("1,2007-03-14 13:44:00,45.1,-75.2,x,Moving,25mph");
  ASSERT_EQ(f.platform.Messages().size(), 2u);
  ReadKelLine(*f, "2007-03-14\t13:43:00.000\t45.1\t-75.2\t10");
  ASSERT_EQ(f.platform.Messages().size(), 3u);
  EXPECT_EQ(f.platform.Messages()[2].text, OutOfSequenceText(3, "track.csv"));
  ReadOrionCsvLine(*f, Orion("2007-03-14 13:42:00.000"));
  f.Read("1,2007-03-14 13:41:00,45.1,-75.2,x,Moving,25mph");
  ReadKelLine(*f, "2007-03-14\t13:40:00\t45.1\t-75.2\t10");
  EXPECT_EQ(f.platform.Messages().size(), 3u);
  EXPECT_EQ(f->Track.PointCount, 7);
}

TEST(ReadCsv2Line, BadLinesAddWhatTheirColumnsSay) {
  Csv2File f;
  f.Read("");
  EXPECT_EQ(f->Track.PointCount, 0);
  f.Read("garbage");
  ASSERT_EQ(f->Track.PointCount, 1);
  EXPECT_EQ(f.At(1).DateTime, " ");  // empty date and time joined by the blank
  EXPECT_DOUBLE_EQ(f.At(1).Latitude, 0);
  EXPECT_DOUBLE_EQ(f.At(1).Speed, 0);
  f.Read(Bytes("\x00\xff\x80,\x01 \x02,\x1b\x1b,,mph\x00"));
  ASSERT_EQ(f->Track.PointCount, 2);
  EXPECT_DOUBLE_EQ(f.At(2).Latitude, 0);
  EXPECT_DOUBLE_EQ(f.At(2).Longitude, 0);
  std::string huge(1 << 20, ' ');
  f.Read(huge);
  ASSERT_EQ(f->Track.PointCount, 3);
  EXPECT_DOUBLE_EQ(f.At(3).Latitude, 0);
  EXPECT_TRUE(f.platform.Messages().empty());
}

}  // namespace
}  // namespace molvar
