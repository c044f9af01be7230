#include "app/TestBox.h"

#include "app/Molvar.h"

namespace molvar {

void AppendToTestBox(Molvar& m, std::string_view text) {
  std::string& box = m.frmMain.txtTest.Text;
  box.append(text).append("\r\n");
  if (box.size() <= kTestBoxLimit) return;
  const std::size_t excess = box.size() - kTestBoxLimit;
  std::size_t cut = box.find('\n', excess);
  cut = cut == std::string::npos ? box.size() : cut + 1;
  box.erase(0, cut);
}

}  // namespace molvar
