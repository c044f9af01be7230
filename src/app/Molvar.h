#pragma once
// The running program: the stores, the windows as data, the conversion state, the open output
// file and each module's own state. Everything the procedures share lives here; a test builds a
// fresh one with a scripted platform.
#include <array>
#include <cstdint>
#include <fstream>
#include <functional>
#include <string>

#include "app/Form.h"
#include "aprs/AprsState.h"
#include "core/SpeedDistance.h"
#include "core/TrackStore.h"
#include "input/ReaderState.h"
#include "output/OutputFile.h"
#include "output/OutputState.h"
#include "platform/Platform.h"

namespace molvar {

enum ProgramModes : int16_t {
  kModeConvertTracks = 0,
  kModeConvertWaypoints = 1,
  kModeGarmin = 2,
  kModeRealTimeNmea = 3,
  kModeAprsWeb = 4,
  kModeAgw = 5,
};

enum OutputModes : int16_t { kOutputGoogleEarth = 0, kOutputGoogleMaps = 1 };
enum OutputFormats : int16_t { kFormatKml = 0, kFormatGpx = 1, kFormatOzi = 2 };

inline constexpr const char* kVersionText = "17.0";

struct Molvar {
  Molvar(Platform& platform, std::string programFolder);
  Molvar(const Molvar&) = delete;
  Molvar& operator=(const Molvar&) = delete;

  Platform& platform;
  std::string ProgramFolder;  // holds Molvar.ini, TrackData.txt, the live files and the resources
  std::string VersionText = kVersionText;

  MainForm frmMain;
  IconSelectForm frmIconSelect;
  FtpSetupForm frmFtpSetup;

  TrackStore Track;
  WaypointStore Waypoints;
  NmeaFix Nmea;

  // Conversion state
  int16_t ProgramMode = kModeConvertTracks;
  int16_t OutputMode = kOutputGoogleEarth;
  int16_t TrackFileType = 0;
  int16_t WptFileType = 0;
  int16_t OutputFormat = kFormatKml;
  int16_t ColorVaryMode = 0;
  int16_t SpeedUnits = 0;
  int16_t AltitudeUnits = 0;
  int16_t AltitudeMode = 0;
  int16_t PlacemarkLabelSource = 0;
  int16_t NorthUp = 0;
  double GmtHours = 0;
  int16_t GmtMinutes = 0;
  std::string LastSourceFile;
  std::string InputName;
  std::string OutputPath;
  std::string OutputName;
  std::string InputTrackPath;
  std::string InputWaypointPath;
  std::string OutputTrackPath;
  std::string OutputPlacemarkPath;
  int16_t TestMode = 0;
  struct {
    int SavedWidth = 0, SavedHeight = 0;  // window size before test mode grew it
  } TestBoxState;

  // Display units
  double UnitFactor = 1.0;
  std::string SpeedUnitLabel = " kph";
  std::string DistanceUnitLabel = " km";
  double AltitudeFactor = 3.28083;
  std::string AltitudeUnitLabel = " feet";

  // Track look
  std::array<std::string, 10> ColorTable{};
  std::array<long, 10> DisplayColorTable{};
  int16_t UserColorPointer = 0;
  int16_t TransparencyLevel = 255;
  int16_t SpeedGain = 8;
  int16_t IconPalette = 2;
  int16_t IconX = 192;
  int16_t IconY = 32;
  int16_t CollapseSegments = 0;
  int16_t AutoOpen = 1;
  int16_t SplitIfStopped = 0;

  // Outside programs and remembered answers
  std::string TextEditorPath;
  std::string GoogleEarthPath;
  std::string AgwProgramPath;
  int16_t IconHintAnswer = 0;
  int16_t ComPortNumber = 1;
  int16_t BaudRateIndex = 0;

  // FTP and e-mail settings
  std::string FtpUserName;
  std::string FtpPassword;
  std::string FtpServer;
  std::string FtpDirectory;
  std::string FtpHttpPath;
  double FtpUploadRate = 0;
  int16_t FtpReady = 0;
  std::string EmailSignature;
  // The FTP module's upload of the last saved output file: count 0 for a manual upload, else the
  // running number of automatic uploads. The writers decide when; the FTP module installs it, and
  // while it is empty there is nothing to upload to.
  std::function<void(Molvar&, int32_t count)> UploadLastFile;

  // The one output file of the writers
  OutputFile Out;
  // agwpe.txt in the program folder, emptied at start and open until shutdown
  std::ofstream AgwpeFile;

  // Module state
  SpeedState Speed;
  OziTrackState OziTrack;
  TextReaderState TextReaders;
  MarkupReaderState GpxReader;
  MarkupReaderState XmlReader;
  NmeaParserState NmeaParser;
  KmlState Kml;
  DetailState Detail;
  GpxState Gpx;
  LiveState Live;
  AprsState Aprs;

  // A path in the program folder.
  std::string ProgramPath(std::string_view relative) const;
};

// Procedures report caught errors through these: "<procedure> snag <description>" with the
// title " Whoa! An error!" (input side), "<procedure> bug <description>" with the title "Error"
// (output side).
void ShowSnag(Molvar& m, std::string_view procedure, const std::exception& e, MsgIcon icon = MsgIcon::Critical);
void ShowBug(Molvar& m, std::string_view procedure, const std::exception& e);

}  // namespace molvar
