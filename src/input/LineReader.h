#pragma once
// Lines of a text file, ended by CR, LF or CR LF, read through a large buffer. Any byte content
// is accepted; a line longer than the limit is cut at the limit and the rest of it skipped, so a
// file without line ends cannot exhaust memory.
#include <cstdio>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace molvar {

class LineReader {
 public:
  static constexpr std::size_t kMaxLineLength = 1 << 20;

  // Raises RuntimeError "File not found" (53) or "Path/File access error" (75) naming the path.
  explicit LineReader(const std::string& path);

  // The next line without its line end; false at the end of the file. The view stays valid until
  // the next call: most lines are handed out straight from the buffer, without a copy. A failed
  // read (a folder, a device error) raises RuntimeError 75 naming the path and the reason instead
  // of passing for the end of the file.
  bool Next(std::string_view& line);
  bool Next(std::string& line);

 private:
  bool Fill();

  struct Closer {
    void operator()(std::FILE* f) const { std::fclose(f); }
  };
  std::string path_;
  std::unique_ptr<std::FILE, Closer> file_;
  std::vector<char> buffer_;
  std::size_t pos_ = 0;
  std::size_t size_ = 0;
  std::string carry_;  // a line that runs across the end of the buffer
  bool eof_ = false;
  bool skipLineFeed_ = false;  // the last line ended with CR: a following LF belongs to it
};

}  // namespace molvar
