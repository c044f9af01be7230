#pragma once
// Outside programs (xmllint, ogrinfo, gpsbabel) run on the files we write.
#include <string>
#include <vector>

namespace molvar::testing {

// Runs a shell command and returns what it printed; `status` gets its exit status.
std::string RunCommand(const std::string& command, int* status = nullptr);

// Checks that each of `items` occurs in `text`, each one at or after the previous one; reports the
// first that does not.
void ExpectInOrder(const std::string& text, const std::vector<std::string>& items);

// xmllint --noout accepts the file (well-formed XML).
void ExpectWellFormedXml(const std::string& path);

}  // namespace molvar::testing
