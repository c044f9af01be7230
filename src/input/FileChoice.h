#pragma once
// Choosing the input and output files of a conversion, and the one rewrite of an input file with
// bare line feeds.
#include <cstdint>
#include <string>
#include <string_view>

namespace molvar {

struct Molvar;

inline constexpr int kTrackFileTypeCount = 9;

// The open dialog's filter for a track file type (empty outside 0..8).
std::string_view TrackFileFilter(int trackFileType);
std::string_view WaypointFileFilter(int wptFileType);

// 1 when cancelled, else 0. Sets LastSourceFile, InputName, the proposed OutputName and the
// remembered input folder.
int16_t ChooseInputFile(Molvar& m);
// 1 when cancelled or when the format combination is refused (after its message), else 0. Sets
// OutputPath, OutputName, OutputFormat and the remembered output folder.
int16_t ChooseOutputFile(Molvar& m);
// The OutputFormat a file name selects, or `previous` when it names none.
int16_t OutputFormatOfName(std::string_view name, int16_t previous);
// The message when this mode, input type and output format cannot go together, else empty.
std::string_view RefusedCombination(const Molvar& m);

// When the first line (ended by CR) of LastSourceFile is longer than 300 characters the file
// probably ends its lines with bare line feeds: those become CR LF, in place and atomically.
void FixLineEnds(Molvar& m);

// Eye altitude at least 100, tilt 0..90 (else 45), heading 0..360 (else 0).
void NormaliseViewSettings(Molvar& m);

}  // namespace molvar
