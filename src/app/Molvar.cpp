#include "app/Molvar.h"

namespace molvar {
namespace {

constexpr std::array<const char*, 10> kColorTable = {"0000FF", "00FF00", "FF0000", "FFFF00", "FF00FF",
                                                     "00FFFF", "4DABFB", "FFC0C0", "E6E6E6", "800080"};

}  // namespace

Molvar::Molvar(Platform& p, std::string programFolder) : platform(p), ProgramFolder(std::move(programFolder)) {
  for (std::size_t i = 0; i < kColorTable.size(); ++i) {
    ColorTable[i] = kColorTable[i];
    DisplayColorTable[i] = std::stol(kColorTable[i], nullptr, 16);
  }
  const std::string samples = ProgramPath("Samples");
  InputTrackPath = samples;
  InputWaypointPath = samples;
  OutputTrackPath = samples;
  OutputPlacemarkPath = samples;
  TextEditorPath = "";
  GoogleEarthPath = "/opt/google/earth/pro/google-earth-pro";
}

std::string Molvar::ProgramPath(std::string_view relative) const {
  std::string p = ProgramFolder;
  if (!p.empty() && p.back() != '/') p.push_back('/');
  p.append(relative);
  return p;
}

void ShowSnag(Molvar& m, std::string_view procedure, const std::exception& e, MsgIcon icon) {
  std::string text(procedure);
  text.append(" snag ");
  text.append(ErrorDescription(e));
  m.platform.MsgBox(text, " Whoa! An error!", MsgButtons::OK, icon);
}

void ShowBug(Molvar& m, std::string_view procedure, const std::exception& e) {
  std::string text(procedure);
  text.append(" bug ");
  text.append(ErrorDescription(e));
  m.platform.MsgBox(text, "Error", MsgButtons::OK, MsgIcon::Exclamation);
}

}  // namespace molvar
