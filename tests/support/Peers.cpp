#include "support/Peers.h"

#include <gtest/gtest.h>

#include <array>
#include <cstdio>
#include <memory>

namespace molvar::testing {

std::string RunCommand(const std::string& command, int* status) {
  std::string out;
  std::unique_ptr<FILE, int (*)(FILE*)> pipe(popen(command.c_str(), "r"), pclose);
  if (!pipe) return out;
  std::array<char, 4096> buf{};
  std::size_t n = 0;
  while ((n = fread(buf.data(), 1, buf.size(), pipe.get())) > 0) out.append(buf.data(), n);
  const int rc = pclose(pipe.release());
  if (status != nullptr) *status = rc;
  return out;
}

void ExpectInOrder(const std::string& text, const std::vector<std::string>& items) {
  std::size_t at = 0;
  for (const auto& item : items) {
    const std::size_t found = text.find(item, at);
    EXPECT_NE(found, std::string::npos) << item << " not in order in:\n" << text;
    if (found == std::string::npos) return;
    at = found + item.size();
  }
}

void ExpectWellFormedXml(const std::string& path) {
  int rc = -1;
  const std::string out = RunCommand("xmllint --noout '" + path + "' 2>&1", &rc);
  EXPECT_EQ(rc, 0) << out;
}

}  // namespace molvar::testing
