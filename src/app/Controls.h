#pragma once
// The window controls as data. Each control keeps the state a procedure may read or set; the Qt
// window renders it and forwards events to the handlers.
#include <map>
#include <string>
#include <vector>

#include "core/Errors.h"

namespace molvar {

struct Control {
  std::string Caption;
  std::string ToolTipText;
  bool Enabled = true;
  bool Visible = true;
};

struct CheckBox : Control {
  int Value = 0;  // 0 unchecked, 1 checked
  bool Checked() const { return Value == 1; }
};

struct OptionButton : Control {
  bool Value = false;
};

struct TextBox : Control {
  std::string Text;
  int Left = 0, Top = 0, Width = 0, Height = 0;  // twips; 0 leaves the window's own layout
};

struct ComboBox : Control {
  std::vector<std::string> List;
  int ListIndex = -1;
  // The text of the selected entry (empty when none).
  std::string Text() const {
    return ListIndex >= 0 && ListIndex < static_cast<int>(List.size()) ? List[static_cast<std::size_t>(ListIndex)]
                                                                        : std::string{};
  }
};

struct CommandButton : Control {
  bool HasFocus = false;
};

struct Label : Control {};

struct Frame : Control {
  bool InFront = false;
};

struct PictureBox : Control {
  std::string Picture;  // file shown, empty for none
  long BackColor = 0;
};

struct Slider : Control {
  int Min = 0;
  int Max = 10;
  int Value = 0;
  // Values outside Min..Max are brought into range, as the slider itself would.
  void Set(int v) { Value = v < Min ? Min : (v > Max ? Max : v); }
};

struct ProgressBar : Control {
  int Min = 0;
  int Max = 100;
  int Value = 0;
};

struct MenuItem : Control {
  bool Checked = false;
  std::string Shortcut;
};

struct Timer {
  int Interval = 0;  // milliseconds
  bool Enabled = false;
};

struct WindowState {
  std::string Caption;
  bool Visible = false;
  bool TopMost = false;
  int Left = 0, Top = 0, Width = 0, Height = 0;  // twips
};

// A control array: elements by index; a missing index raises error 340.
template <typename T>
class ControlArray {
 public:
  T& operator()(int index) {
    auto it = items_.find(index);
    if (it == items_.end()) throw RuntimeError(kErrNoControlElement);
    return it->second;
  }
  const T& operator()(int index) const {
    auto it = items_.find(index);
    if (it == items_.end()) throw RuntimeError(kErrNoControlElement);
    return it->second;
  }
  T& Add(int index) { return items_[index]; }
  bool Has(int index) const { return items_.count(index) != 0; }
  std::map<int, T>& Items() { return items_; }
  const std::map<int, T>& Items() const { return items_; }

 private:
  std::map<int, T> items_;
};

// Option buttons and radio menu groups: the index of the selected element, -1 when none.
inline int SelectedIndex(const ControlArray<OptionButton>& group) {
  for (const auto& [i, b] : group.Items()) {
    if (b.Value) return i;
  }
  return -1;
}
inline int SelectedIndex(const ControlArray<MenuItem>& group) {
  for (const auto& [i, m] : group.Items()) {
    if (m.Checked) return i;
  }
  return -1;
}
// Selects one element of the group and clears the others.
inline void SelectOnly(ControlArray<OptionButton>& group, int index) {
  for (auto& [i, b] : group.Items()) b.Value = i == index;
}
inline void CheckOnly(ControlArray<MenuItem>& group, int index) {
  for (auto& [i, m] : group.Items()) m.Checked = i == index;
}

}  // namespace molvar
