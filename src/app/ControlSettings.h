#pragma once
// Setting an option by control name ("chkDetailed=0", "chkSplitColor(2)=1", "mnuUnitsItem=1"):
// the value goes into the control and the handler a click would run follows.
#include <optional>
#include <string>
#include <string_view>

namespace molvar {

struct Molvar;

struct ControlAssignment {
  std::string name;
  int index = -1;  // element of a control array; -1 when none was given
  std::string value;
};

// "NAME=VALUE" or "NAME(INDEX)=VALUE"; nothing when the text has neither form.
std::optional<ControlAssignment> ParseControlAssignment(std::string_view text);

// Empty when applied, else what is wrong ("unknown control ...", "bad value ...").
std::string ApplyControlAssignment(Molvar& m, const ControlAssignment& assignment);

}  // namespace molvar
