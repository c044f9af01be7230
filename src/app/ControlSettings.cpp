#include "app/ControlSettings.h"

#include <functional>
#include <map>

#include "app/Molvar.h"
#include "app/Options.h"
#include "core/Numbers.h"
#include "core/Text.h"

namespace molvar {
namespace {

// A control array that stands for one choice ("mnuUnitsItem=1" selects item 1).
bool IsChoiceGroup(std::string_view name) {
  return StartsWith(name, "opt") || name == "mnuUnitsItem" || name == "mnuDistItem" || name == "mnuOutputMode" ||
         name == "mnuComNumber" || name == "mnuComBaud";
}

using Handler = std::function<void(Molvar&, int)>;

// What a click on the control runs once its value has changed.
const std::map<std::string, Handler, std::less<>>& Handlers() {
  static const std::map<std::string, Handler, std::less<>> handlers = {
      {"chkSplitColor", [](Molvar& m, int i) { ApplySplitColor(m, i); }},
      {"chkCollapse", [](Molvar& m, int) { ApplyCollapse(m); }},
      {"chkSplitIfStopped", [](Molvar& m, int) { ApplySplitIfStopped(m); }},
      {"chkDetailed", [](Molvar& m, int) { ApplyDetailed(m); }},
      {"chkUseFilename", [](Molvar& m, int) { ApplyUseFilename(m); }},
      {"chkAuto", [](Molvar& m, int) { ApplyAutoOpen(m); }},
      {"optWptFileType", [](Molvar& m, int i) { SelectWptFileType(m, i); }},
      {"optWptTitle", [](Molvar& m, int i) { SelectWptTitle(m, i); }},
      {"optNorthUp", [](Molvar& m, int i) { SelectNorthUp(m, i); }},
      {"comboAltitude", [](Molvar& m, int i) { SelectAltitudeMode(m, i); }},
      {"comboTrackFileType", [](Molvar& m, int i) { SelectTrackFileType(m, i); }},
      {"sldrGain", [](Molvar& m, int) { ApplyGain(m); }},
      {"sldrFade", [](Molvar& m, int) { ApplyFade(m); }},
      {"txtGMT", [](Molvar& m, int) { ApplyGmtText(m); }},
      {"mnuUnitsItem", [](Molvar& m, int i) { SelectSpeedUnits(m, i); }},
      {"mnuDistItem", [](Molvar& m, int i) { SelectAltitudeUnits(m, i); }},
      {"mnuOutputMode", [](Molvar& m, int i) { SelectOutputMode(m, i); }},
      {"mnuComNumber", [](Molvar& m, int i) { SelectComPort(m, i); }},
      {"mnuComBaud", [](Molvar& m, int i) { SelectBaudRate(m, i); }},
  };
  return handlers;
}

bool WholeNumber(std::string_view text, int lo, int hi, int& out) {
  double v = 0;
  if (!TryParseNumber(text, v) || v != static_cast<double>(static_cast<long long>(v)) || v < lo || v > hi)
    return false;
  out = static_cast<int>(v);
  return true;
}

std::string BadValue(const ControlAssignment& a, std::string_view expected) {
  return "bad value \"" + a.value + "\" for " + a.name + " (" + std::string(expected) + ")";
}

// Puts the value into the control; the index of the choice it makes, or an error text.
struct Outcome {
  int index = -1;
  std::string error;
};

Outcome StoreValue(const ControlAssignment& a, const ControlRef& control, int elementIndex) {
  Outcome out;
  out.index = elementIndex;
  int v = 0;
  if (auto* box = std::get_if<CheckBox*>(&control)) {
    if (!WholeNumber(a.value, 0, 1, v)) return {-1, BadValue(a, "0 or 1")};
    (*box)->Value = v;
  } else if (auto* text = std::get_if<TextBox*>(&control)) {
    (*text)->Text = a.value;
  } else if (auto* combo = std::get_if<ComboBox*>(&control)) {
    const int last = static_cast<int>((*combo)->List.size()) - 1;
    if (!WholeNumber(a.value, 0, last, v)) return {-1, BadValue(a, "0 to " + IntToText(last))};
    (*combo)->ListIndex = v;
    out.index = v;
  } else if (auto* slider = std::get_if<Slider*>(&control)) {
    if (!WholeNumber(a.value, (*slider)->Min, (*slider)->Max, v))
      return {-1, BadValue(a, IntToText((*slider)->Min) + " to " + IntToText((*slider)->Max))};
    (*slider)->Value = v;
  } else if (auto* item = std::get_if<MenuItem*>(&control)) {
    if (!WholeNumber(a.value, 0, 1, v)) return {-1, BadValue(a, "0 or 1")};
    (*item)->Checked = v == 1;
  } else {
    return {-1, a.name + " is not an option that can be set"};
  }
  return out;
}

}  // namespace

std::optional<ControlAssignment> ParseControlAssignment(std::string_view text) {
  const std::size_t eq = text.find('=');
  if (eq == std::string_view::npos || eq == 0) return std::nullopt;
  ControlAssignment a;
  std::string_view name = text.substr(0, eq);
  a.value = std::string(text.substr(eq + 1));
  const std::size_t open = name.find('(');
  if (open != std::string_view::npos) {
    if (name.back() != ')' || open == 0) return std::nullopt;
    int index = 0;
    if (!WholeNumber(name.substr(open + 1, name.size() - open - 2), 0, 99, index)) return std::nullopt;
    a.index = index;
    name = name.substr(0, open);
  }
  a.name = std::string(name);
  return a;
}

std::string ApplyControlAssignment(Molvar& m, const ControlAssignment& a) {
  if (a.name == "mnuModeItem") return "mnuModeItem is chosen by the file type, not set";
  const std::vector<ControlEntry> controls = m.frmMain.Controls();
  int elementIndex = a.index;
  if (a.index < 0 && IsChoiceGroup(a.name)) {
    // "NAME=k" on a choice group selects element k.
    int k = 0;
    if (!WholeNumber(a.value, 0, 99, k) || FindControl(controls, a.name, k) == nullptr) {
      if (FindControl(controls, a.name, 0) == nullptr && FindControl(controls, a.name, 1) == nullptr)
        return "unknown control " + a.name;
      return BadValue(a, "an element number of the group");
    }
    elementIndex = k;
  } else {
    const ControlEntry* entry = FindControl(controls, a.name, a.index);
    if (entry == nullptr) {
      if (a.index < 0 && FindControl(controls, a.name, 0) != nullptr)
        return a.name + " is a control array: give its index, as in " + a.name + "(0)=" + a.value;
      return a.index < 0 ? "unknown control " + a.name
                         : "unknown control " + a.name + "(" + IntToText(a.index) + ")";
    }
    if (IsChoiceGroup(a.name)) {
      // "NAME(k)=1" selects element k; clearing a choice leaves the group without one.
      int v = 0;
      if (!WholeNumber(a.value, 1, 1, v)) return BadValue(a, "1 selects the element");
    } else {
      const Outcome out = StoreValue(a, entry->control, a.index);
      if (!out.error.empty()) return out.error;
      elementIndex = out.index;
    }
  }
  if (const auto it = Handlers().find(a.name); it != Handlers().end()) it->second(m, elementIndex);
  return {};
}

}  // namespace molvar
