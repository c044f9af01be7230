// Outside text in KML: whatever a user types or a file holds, the document stays well-formed and
// readable by Google Earth's peers, and references that are already escaped stay as they are.
#include <gtest/gtest.h>

#include <filesystem>
#include <memory>
#include <string>

#include "output/kml/KmlFrame.h"
#include "core/Markup.h"
#include "output/kml/Placemarks.h"
#include "output/kml/Segments.h"
#include "core/SpeedDistance.h"
#include "support/KmlTesting.h"

namespace molvar {
namespace {

using testing::Coord;
using testing::ExpectPeersRead;
using testing::ReadFile;
using testing::TestProgram;
using testing::WriteTrack;

bool Has(const std::string& text, const std::string& part) { return text.find(part) != std::string::npos; }

TEST(MarkupSafety, EscapesOnlyWhatWouldBreakTheDocument) {
  EXPECT_EQ(MarkupText("Fish & Chips <best> \"q\" 'a'"), "Fish &amp; Chips &lt;best> \"q\" 'a'");
  EXPECT_EQ(MarkupText("Salt &amp; Pepper"), "Salt &amp; Pepper");
  EXPECT_EQ(MarkupText("&lt;&gt;&quot;&apos;&#176;&#xB0;"), "&lt;&gt;&quot;&apos;&#176;&#xB0;");
  EXPECT_EQ(MarkupText("a]]>b"), "a]]&gt;b");
  EXPECT_EQ(MarkupText("a]]]>b ]>"), "a]]]&gt;b ]>");
  EXPECT_EQ(MarkupText("& &; &#; &x"), "&amp; &amp;; &amp;#; &amp;x");
}

TEST(MarkupSafety, ReferencesAReaderCannotResolveAreEscapedAgain) {
  EXPECT_EQ(MarkupText("a&nbsp;b"), "a&amp;nbsp;b");
  EXPECT_EQ(MarkupText("&#0;&#xD800;&#x110000;&#99999999999;"), "&amp;#0;&amp;#xD800;&amp;#x110000;&amp;#99999999999;");
  EXPECT_EQ(MarkupText("&#9;&#x10FFFF;"), "&#9;&#x10FFFF;");
}

TEST(MarkupSafety, ForbiddenCharactersCannotHideAClosingSequence) {
  EXPECT_EQ(MarkupText("]]\x01>"), "]]&gt;");
  EXPECT_EQ(MarkupText("caf\xE9"), "caf\xC3\xA9");  // Latin-1 into UTF-8
}

TEST(MarkupSafety, CommentsLoseDoubleDashesAndKeepTheRest) {
  EXPECT_EQ(MarkupComment("a--b"), "a- -b");
  EXPECT_EQ(MarkupComment("a---b-"), "a- - -b-");
  EXPECT_EQ(MarkupComment("x ]]> & <y>"), "x ]]> & <y>");
  EXPECT_EQ(MarkupComment("bell\x07"), "bell");
}

constexpr const char* kNasty = "Tom's \"Bar\" & <Grill> ]]> --- &amp; &nbsp;";

TEST(MarkupSafety, TrackDocumentWithHostileTextsStaysReadable) {
  TestProgram t;
  // A program folder whose name needs escaping too.
  const std::filesystem::path folder = t.folder.path() / "R&D <x> ]]>";
  std::filesystem::create_directories(folder);
  t.m = std::make_unique<Molvar>(t.platform, folder.string());
  Molvar& m = *t;
  t.AddPoint(45.0, -75.0, "2007-05-01 10:00:00 AM");
  t.AddPoint(45.01, -75.0, "2007-05-01 10:01:00 AM");
  m.Track.at(2).PointText = std::string(kNasty);
  m.ColorVaryMode = 3;
  m.frmMain.chkBalloon.Value = 1;
  m.frmMain.chkUseFilename.Value = 0;
  m.frmMain.txtTitle.Text = kNasty;
  m.frmMain.txtTilt.Text = "4<5 & ]]>";
  m.frmMain.chkAuto.Value = 0;
  m.OutputPath = (folder / "a&b.kml").string();
  m.OutputName = "a&b <1>.kml";
  MarkDays(m);
  MarkSegments(m);
  m.Speed.FastestIndex = FindFastestPoint(m);
  ASSERT_EQ(WriteKmlHeader(m), 0);
  WriteKmlSegments(m);
  WriteKmlFooter(m);
  const std::string path = m.OutputPath;
  const std::string doc = ReadFile(path);
  EXPECT_TRUE(Has(doc, "<name>Tom's \"Bar\" &amp; &lt;Grill> ]]&gt; --- &amp; &amp;nbsp;</name>")) << doc;
  EXPECT_TRUE(Has(doc, "   <br></br>Tom's \"Bar\" & <Grill> ]]]]><![CDATA[> --- &amp; &nbsp;\r\n")) << doc;
  EXPECT_TRUE(Has(doc, "File a&amp;b &lt;1>.kml details\r\n"));
  EXPECT_TRUE(Has(doc, "<href>" + MarkupText(folder.string()) + "/SpeedLegend.jpg</href>"));
  EXPECT_TRUE(Has(doc, "  <tilt>4&lt;5 &amp; ]]&gt;</tilt>"));
  EXPECT_TRUE(t.platform.Messages().empty());
  ExpectPeersRead(path, {{-75, 45, 0}, {-75, 45.01, 0}, {-75, 45, 0}, {-75, 45.01, 0}, {-75, 45.01, 0}},
                  {{{-75, 45, 0}, {-75, 45.01, 0}}});
}

TEST(MarkupSafety, GoogleMapsSegmentNamesAndWaypointNamesStayReadable) {
  TestProgram t;
  Molvar& m = *t;
  t.AddPoint(45.0, -75.0, "2007-05-01 10:00:00 AM");
  t.AddPoint(45.01, -75.0, "2007-05-01 10:01:00 AM");
  m.OutputMode = kOutputGoogleMaps;
  m.frmMain.chkAuto.Value = 0;
  t.platform.inputAnswers = {kNasty};
  WriteTrack(t, "maps.kml");
  const std::string maps = t.folder.File("maps.kml");
  EXPECT_TRUE(Has(ReadFile(maps), "  <name>Tom's \"Bar\" &amp; &lt;Grill> ]]&gt; --- &amp; &amp;nbsp;</name>\r\n"));
  ExpectPeersRead(maps, {{-75, 45, 0}, {-75, 45.01, 0}, {-75, 45.01, 0}}, {{{-75, 45, 0}, {-75, 45.01, 0}}});

  TestProgram w;
  Molvar& mw = *w;
  mw.ProgramMode = kModeConvertWaypoints;
  mw.OutputPath = w.folder.File("w.kml");
  mw.OutputName = "w.kml";
  ASSERT_EQ(WriteKmlHeader(mw), 0);
  int32_t alt = 0;
  WriteKmlPlacemark(mw, kNasty, 2.5, 48.75, alt, "FFFFFF", kPlacemarkGeneral);
  mw.frmIconSelect.chkCustomIcon.Value = 1;
  WriteKmlPlacemark(mw, "-dash-", 2.25, 48.5, alt, "FFFFFF", kPlacemarkGeneral);
  WriteKmlFooter(mw);
  const std::string doc = ReadFile(w.folder.File("w.kml"));
  EXPECT_TRUE(Has(doc, "<!--  Write \"Tom's \"Bar\" & <Grill> ]]> - - - &amp; &nbsp;\" Placemark  -->\r\n"));
  EXPECT_TRUE(Has(doc, "<!--  Write \"-dash-\" Placemark  -->\r\n"));
  ExpectPeersRead(w.folder.File("w.kml"), {{2.5, 48.75, 0}, {2.25, 48.5, 0}}, {});
}

}  // namespace
}  // namespace molvar
