#pragma once
// "Read track file": choose the files, read every line through the reader of the chosen type, and
// hand the store to the output dispatcher.
#include <string>
#include <string_view>

namespace molvar {

struct Molvar;

// `fromDrop`: the file names were set by the drop handler, no dialogs.
void ReadTrackFile(Molvar& m, bool fromDrop);

// A file dropped on the track frame.
void TrackFrame_Drop(Molvar& m, const std::string& path);

// Sets LastSourceFile, InputName, OutputPath and OutputName for a dropped file (the output beside
// it, named like it with ".kml") and returns its extension, upper-cased.
std::string TakeDroppedFile(Molvar& m, const std::string& path);

// One line of an APRS text file: the short form, or the packet after ">" with the time in front.
void ReadAprsFileLine(Molvar& m, std::string_view line);

}  // namespace molvar
