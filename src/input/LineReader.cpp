#include "input/LineReader.h"

#include <cerrno>
#include <cstring>

#include "core/Errors.h"

namespace molvar {
namespace {
constexpr std::size_t kChunk = 1 << 20;
}  // namespace

LineReader::LineReader(const std::string& path) : path_(path), file_(std::fopen(path.c_str(), "rb")) {
  if (!file_) {
    const int err = errno;
    throw FileError(err == ENOENT ? kErrFileNotFound : kErrPathFileAccess, path, err);
  }
}

bool LineReader::Fill() {
  if (eof_) return false;
  buffer_.erase(0, pos_);
  pos_ = 0;
  const std::size_t old = buffer_.size();
  buffer_.resize(old + kChunk);
  errno = 0;
  const std::size_t got = std::fread(buffer_.data() + old, 1, kChunk, file_.get());
  const int err = errno;
  buffer_.resize(old + got);
  if (got < kChunk) {
    if (std::ferror(file_.get())) throw FileError(kErrPathFileAccess, path_, err != 0 ? err : EIO);
    eof_ = true;
  }
  return got > 0;
}

bool LineReader::Next(std::string& line) {
  line.clear();
  bool any = false;
  bool truncated = false;
  for (;;) {
    if (pos_ >= buffer_.size() && !Fill()) return any;
    if (skipLineFeed_) {
      skipLineFeed_ = false;
      if (buffer_[pos_] == '\n') {
        ++pos_;
        continue;
      }
    }
    const char* start = buffer_.data() + pos_;
    const std::size_t available = buffer_.size() - pos_;
    const void* cr = std::memchr(start, '\r', available);
    const void* lf = std::memchr(start, '\n', available);
    const char* end = nullptr;
    if (cr && lf) end = static_cast<const char*>(cr < lf ? cr : lf);
    else end = static_cast<const char*>(cr ? cr : lf);
    const std::size_t length = end ? static_cast<std::size_t>(end - start) : available;
    if (!truncated) {
      const std::size_t room = kMaxLineLength - line.size();
      line.append(start, length < room ? length : room);
      truncated = line.size() >= kMaxLineLength;
    }
    any = true;
    if (end) {
      pos_ += length + 1;
      skipLineFeed_ = *end == '\r';
      return true;
    }
    pos_ += length;
  }
}

}  // namespace molvar
