#pragma once
// One text file being written: 8-bit text, CR LF after every line, gathered in a large buffer and
// written to a temporary file beside the target, which replaces the target only when the file is
// closed complete. Readers of the target (Google Earth reloading a live file) never see half a
// file, and a failed write leaves the previous file as it was.
#include <cstdio>
#include <filesystem>
#include <string>
#include <string_view>

namespace molvar {

class OutputFile {
 public:
  OutputFile() = default;
  OutputFile(const OutputFile&) = delete;
  OutputFile& operator=(const OutputFile&) = delete;
  ~OutputFile() { Abandon(); }

  // Opens `path` for writing (a file still open is abandoned first). Raises RuntimeError with the
  // file and the reason when the temporary file cannot be created.
  void Open(const std::string& path);
  bool IsOpen() const { return file_ != nullptr; }
  const std::string& Path() const { return path_; }

  // Text of the line being built; EndLine() ends it with CR LF.
  std::string& Text() { return buffer_; }
  void EndLine();
  // The text followed by CR LF.
  void Line(std::string_view text);
  // Many lines at once: `text` already holds its line ends.
  void Raw(std::string_view text);

  // Writes what is left and puts the file in place of the target. Raises RuntimeError (and
  // leaves the target untouched) when any write failed.
  void Close();
  // How many files were put in place so far.
  int CompletedCount() const { return completed_; }
  // Drops the temporary file; the target is untouched.
  void Abandon();

  // Flushed to the disk before it replaces the target (settings and track data).
  void SetDurable(bool durable) { durable_ = durable; }
  // Readable and writable by the owner only (files that hold a password).
  void SetPrivate(bool privateFile) { private_ = privateFile; }

 private:
  void FlushIfFull();
  void Flush();
  [[noreturn]] void Fail(int err);

  static constexpr std::size_t kFlushSize = 1 << 20;

  std::FILE* file_ = nullptr;
  std::string path_;
  std::filesystem::path temp_;
  std::string buffer_;
  int error_ = 0;
  bool durable_ = false;
  bool private_ = false;
  int completed_ = 0;
};

// Whole-file writes through OutputFile: `content` already holds its line ends.
void WriteFileAtomically(const std::string& path, std::string_view content, bool durable, bool privateFile);

}  // namespace molvar
