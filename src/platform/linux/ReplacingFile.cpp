#include "platform/linux/ReplacingFile.h"

#include <fcntl.h>
#include <unistd.h>
#include <cerrno>
#include <cstdio>

#include <array>
#include <filesystem>
#include <random>

#include "platform/linux/Descriptor.h"
#include "platform/linux/FileError.h"

namespace {

constexpr std::string_view UnfinishedStart = ".new-";

// The path behind all symbolic links at the end of `path`; it need not exist.
std::string FollowLinks(std::string path) {
  constexpr int mostLinks = 40;
  for (int links = 0; links < mostLinks; ++links) {
    std::error_code error;
    const std::filesystem::path target = std::filesystem::read_symlink(path, error);
    if (error) {
      return path;
    }
    path = std::filesystem::path(path).parent_path() / target;
  }
  throw FileError(ELOOP, path);
}

std::string FolderOf(const std::string& path) {
  const std::string parent = std::filesystem::path(path).parent_path();
  return parent.empty() ? "." : parent;
}

}  // namespace

/// A new, empty file with a unique name, deleted at the end unless it has been renamed.
class ReplacingFile::TemporaryFile {
 public:
  TemporaryFile(const std::string& folder, mode_t mode)
      : path_(NewNameIn(folder)), file_(Create(path_, mode)) {}
  ~TemporaryFile() {
    if (!renamed_) {
      unlink(path_.c_str());
    }
  }
  TemporaryFile(const TemporaryFile&) = delete;
  TemporaryFile& operator=(const TemporaryFile&) = delete;

  int Number() const { return file_.Number(); }

  bool RenameTo(const std::string& path) {
    renamed_ = rename(path_.c_str(), path.c_str()) == 0;
    if (!renamed_) {
      const int error = errno;
      renamed_ = IsAt(path);  // network file systems can report a rename as failed that was done
      errno = error;
    }
    return renamed_;
  }

 private:
  bool IsAt(const std::string& path) const {
    struct stat own {};
    struct stat there {};
    return fstat(Number(), &own) == 0 && stat(path.c_str(), &there) == 0 && own.st_dev == there.st_dev &&
           own.st_ino == there.st_ino;
  }
  static int Create(const std::string& path, mode_t mode) {
    return open(path.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, mode);
  }

  std::string path_;
  Descriptor file_;
  bool renamed_ = false;
};

std::string NewNameIn(const std::string& folder) {
  std::random_device random;
  std::array<char, 32> number{};
  std::snprintf(number.data(), number.size(), "%08x%08x", random(), random());
  return std::string(folder).append("/").append(UnfinishedStart).append(number.data());
}

bool IsUnfinishedName(std::string_view name) {
  constexpr std::size_t digits = 16;
  return name.size() == UnfinishedStart.size() + digits && name.starts_with(UnfinishedStart) &&
         name.find_first_not_of("0123456789abcdef", UnfinishedStart.size()) == std::string_view::npos;
}

bool WriteAll(int file, std::string_view bytes) {
  while (!bytes.empty()) {
    const ssize_t written = write(file, bytes.data(), bytes.size());
    if (written < 0 && errno != EINTR) {
      return false;
    }
    bytes.remove_prefix(written < 0 ? 0 : static_cast<std::size_t>(written));
  }
  return true;
}

bool TakeOver(int file, const struct stat& old) {
  struct stat own {};
  if (fstat(file, &own) != 0) {
    return false;
  }
  // Only root may give a file away; for anyone else the new file belongs to the writer.
  if ((own.st_uid != old.st_uid || own.st_gid != old.st_gid) && fchown(file, old.st_uid, old.st_gid) != 0 &&
      errno != EPERM) {
    return false;
  }
  return fchmod(file, old.st_mode & 07777) == 0;
}

void SyncRename(const std::string& folder, const std::string& path) {
  const Descriptor descriptor(open(folder.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC));
  if (descriptor.Number() < 0 || (fsync(descriptor.Number()) != 0 && errno != EINVAL)) {
    const RuntimeError error = FileError(errno, path);
    throw RuntimeError(error.Number(),
                       error.what() + std::string(" (done, but a power failure may undo it)"));
  }
}

ReplacingFile::ReplacingFile(const std::string& path, FileReaders readers)
    : path_(path), target_(FollowLinks(path)), folder_(FolderOf(target_)) {
  struct stat old {};
  const bool exists = stat(target_.c_str(), &old) == 0;
  if (exists && !S_ISREG(old.st_mode)) {
    throw FileError(EISDIR, path_);
  }
  if (exists && faccessat(AT_FDCWD, target_.c_str(), W_OK, AT_EACCESS) != 0) {
    throw FileError(errno, path_);
  }
  const bool isPrivate = readers == FileReaders::ThisUser;
  file_ = std::make_unique<TemporaryFile>(folder_, isPrivate ? 0600 : 0644);
  if (file_->Number() < 0 || (exists && !isPrivate && !TakeOver(file_->Number(), old))) {
    throw FileError(errno, path_);
  }
}

ReplacingFile::~ReplacingFile() = default;

void ReplacingFile::Write(std::string_view bytes) {
  if (!WriteAll(file_->Number(), bytes)) {
    throw FileError(errno, path_);
  }
}

void ReplacingFile::Finish() {
  if (fsync(file_->Number()) != 0 || !file_->RenameTo(target_)) {
    throw FileError(errno, path_);
  }
  SyncRename(folder_, path_);
}
