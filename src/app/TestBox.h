#pragma once
// Test mode: the test box echoes what the input side receives, and lists the track store.
#include <cstddef>
#include <string_view>

namespace molvar {

struct Molvar;

inline constexpr std::size_t kTestBoxLimit = 1u << 20;

// Appends `text` and CR LF to txtTest. The box keeps at most kTestBoxLimit characters: the oldest
// lines go first, so a long session in test mode cannot grow without bound.
void AppendToTestBox(Molvar& m, std::string_view text);

// The test-mode menu item was clicked: its check mark flips and the window grows or shrinks.
void mnuTestItem_Click(Molvar& m);
void cmdClearTestBox_Click(Molvar& m);
// "Show track array": the first 500 points in stored units.
void DisplayTrackArray(Molvar& m);
void cmdDisplayArray_Click(Molvar& m);

}  // namespace molvar
