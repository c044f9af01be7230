#pragma once
// The test box: what the input side receives, echoed while test mode is on.
#include <string_view>

namespace molvar {

struct Molvar;

// Appends `text` and CR LF to txtTest. The box keeps at most kTestBoxLimit characters: the oldest
// lines go first, so a long session in test mode cannot grow without bound.
void AppendToTestBox(Molvar& m, std::string_view text);

inline constexpr std::size_t kTestBoxLimit = 4u << 20;

}  // namespace molvar
