#include "input/LineReader.h"

#include <cerrno>
#include <cstring>

#include "core/Errors.h"

namespace molvar {
namespace {

constexpr std::size_t kChunk = 1 << 20;

// The first CR or LF of [start, start + n), or nullptr. The LF is found first so that a file
// without CR is never scanned to the end of the buffer for every line.
const char* FindLineEnd(const char* start, std::size_t n) {
  const auto* lf = static_cast<const char*>(std::memchr(start, '\n', n));
  const std::size_t before = lf ? static_cast<std::size_t>(lf - start) : n;
  const auto* cr = static_cast<const char*>(std::memchr(start, '\r', before));
  return cr ? cr : lf;
}

}  // namespace

LineReader::LineReader(const std::string& path) : path_(path), file_(std::fopen(path.c_str(), "rb")) {
  if (!file_) {
    const int err = errno;
    throw FileError(err == ENOENT ? kErrFileNotFound : kErrPathFileAccess, path, err);
  }
  buffer_.resize(kChunk);
}

bool LineReader::Fill() {
  pos_ = size_ = 0;
  if (eof_) return false;
  errno = 0;
  size_ = std::fread(buffer_.data(), 1, kChunk, file_.get());
  const int err = errno;
  if (size_ < kChunk) {
    // A failed read (a folder, a device error) must not pass for the end of the file.
    if (std::ferror(file_.get())) throw FileError(kErrPathFileAccess, path_, err != 0 ? err : EIO);
    eof_ = true;
  }
  return size_ > 0;
}

bool LineReader::Next(std::string_view& line) {
  carry_.clear();
  bool any = false;
  for (;;) {
    if (pos_ >= size_ && !Fill()) {
      line = carry_;
      return any;
    }
    if (skipLineFeed_) {
      skipLineFeed_ = false;
      if (buffer_[pos_] == '\n') {
        ++pos_;
        continue;
      }
    }
    const char* start = buffer_.data() + pos_;
    const std::size_t available = size_ - pos_;
    const char* end = FindLineEnd(start, available);
    const std::size_t length = end ? static_cast<std::size_t>(end - start) : available;
    any = true;
    if (end) {
      pos_ += length + 1;
      skipLineFeed_ = *end == '\r';
      if (carry_.empty()) {
        line = std::string_view(start, length < kMaxLineLength ? length : kMaxLineLength);
        return true;
      }
    } else {
      pos_ += length;
    }
    const std::size_t room = kMaxLineLength - carry_.size();
    carry_.append(start, length < room ? length : room);
    if (end) {
      line = carry_;
      return true;
    }
  }
}

bool LineReader::Next(std::string& line) {
  std::string_view view;
  const bool got = Next(view);
  line.assign(view);
  return got;
}

}  // namespace molvar
