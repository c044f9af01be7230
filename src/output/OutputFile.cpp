#include "output/OutputFile.h"

#include <cerrno>
#include <system_error>

#include "core/Errors.h"

#if defined(__unix__) || defined(__APPLE__)
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>
#define MOLVAR_POSIX 1
#endif

namespace molvar {
namespace {

int ErrorNumberFor(int err) {
  switch (err) {
    case ENOENT:
    case ENOTDIR: return kErrPathNotFound;
    case ENOSPC:
#ifdef EDQUOT
    case EDQUOT:
#endif
      return kErrDiskFull;
    case EACCES:
    case EPERM:
    case EROFS: return kErrPermissionDenied;
    default: return kErrPathFileAccess;
  }
}

// Never reuses a file another writer has made; a private file is never readable by others, not
// even for a moment.
std::FILE* CreateNew(const std::filesystem::path& path, bool privateFile) {
#ifdef MOLVAR_POSIX
  const int fd = ::open(path.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, privateFile ? 0600 : 0666);
  if (fd < 0) return nullptr;
  std::FILE* f = ::fdopen(fd, "wb");
  if (f == nullptr) {
    const int err = errno;
    ::close(fd);
    errno = err;
  }
  return f;
#else
  (void)privateFile;
  return std::fopen(path.string().c_str(), "wbx");
#endif
}

}  // namespace

void OutputFile::Open(const std::string& path) {
  Abandon();
  path_ = path;
  error_ = 0;
  buffer_.clear();
  buffer_.reserve(kFlushSize + 4096);
  const std::filesystem::path target(path);
  const std::filesystem::path folder = target.has_parent_path() ? target.parent_path() : std::filesystem::path(".");
  for (int attempt = 0; attempt < 1000; ++attempt) {
    std::string name(".");
    name.append(target.filename().string()).append(".tmp~").append(std::to_string(attempt));
    temp_ = folder / name;
    file_ = CreateNew(temp_, private_);
    if (file_ != nullptr) break;
    if (errno != EEXIST) Fail(errno);
  }
  if (file_ == nullptr) Fail(EEXIST);
}

void OutputFile::EndLine() {
  buffer_.append("\r\n");
  FlushIfFull();
}

void OutputFile::Line(std::string_view text) {
  buffer_.append(text);
  EndLine();
}

void OutputFile::Raw(std::string_view text) {
  buffer_.append(text);
  FlushIfFull();
}

void OutputFile::FlushIfFull() {
  if (buffer_.size() >= kFlushSize) Flush();
}

void OutputFile::Flush() {
  if (file_ == nullptr) {
    buffer_.clear();
    return;
  }
  if (!buffer_.empty() && error_ == 0) {
    if (std::fwrite(buffer_.data(), 1, buffer_.size(), file_) != buffer_.size()) error_ = errno != 0 ? errno : EIO;
  }
  buffer_.clear();
}

void OutputFile::Close() {
  if (file_ == nullptr) throw RuntimeError(kErrBadFileName);
  Flush();
  if (error_ == 0 && std::fflush(file_) != 0) error_ = errno != 0 ? errno : EIO;
#ifdef MOLVAR_POSIX
  if (error_ == 0 && durable_ && ::fsync(::fileno(file_)) != 0) error_ = errno;
#endif
  if (std::fclose(file_) != 0 && error_ == 0) error_ = errno != 0 ? errno : EIO;
  file_ = nullptr;
  if (error_ != 0) {
    const int err = error_;
    Abandon();
    Fail(err);
  }
  std::error_code ec;
  std::filesystem::rename(temp_, path_, ec);
  if (ec) {
    Abandon();
    Fail(ec.value());
  }
  temp_.clear();
  ++completed_;
}

void OutputFile::Abandon() {
  if (file_ != nullptr) {
    std::fclose(file_);
    file_ = nullptr;
  }
  if (!temp_.empty()) {
    std::error_code ec;
    std::filesystem::remove(temp_, ec);
    temp_.clear();
  }
  buffer_.clear();
}

void OutputFile::Fail(int err) {
  const int number = ErrorNumberFor(err);
  throw FileError(number, path_, err);
}

void WriteFileAtomically(const std::string& path, std::string_view content, bool durable, bool privateFile) {
  OutputFile f;
  f.SetDurable(durable);
  f.SetPrivate(privateFile);
  f.Open(path);
  f.Raw(content);
  f.Close();
}

}  // namespace molvar
