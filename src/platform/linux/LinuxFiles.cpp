#include "platform/linux/LinuxFiles.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>
#include <cerrno>
#include <cstdio>

#include <algorithm>
#include <array>
#include <filesystem>
#include <limits>
#include <random>
#include <string_view>
#include <utility>

#include "platform/linux/Descriptor.h"
#include "platform/linux/FileError.h"

namespace {

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

// A new, empty file with a unique name, deleted at the end unless it has been renamed.
class TemporaryFile {
 public:
  TemporaryFile(const std::string& folder, mode_t mode)
      : path_(NewName(folder)), file_(Create(path_, mode)) {}
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
  static std::string NewName(const std::string& folder) {
    std::random_device random;
    std::array<char, 32> name{};
    std::snprintf(name.data(), name.size(), ".new-%08x%08x", random(), random());
    return folder + "/" + name.data();
  }
  static int Create(const std::string& path, mode_t mode) {
    return open(path.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, mode);
  }

  std::string path_;
  Descriptor file_;
  bool renamed_ = false;
};

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

// Gives the new file the old one's permissions and, where allowed, its owner.
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

// Makes it durable that `path` now names a file which was renamed to it, in `folder`. File systems that do
// not support this (EINVAL) count as done. The error says that the file is in its place all the same.
void SyncRename(const std::string& folder, const std::string& path) {
  const Descriptor descriptor(open(folder.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC));
  if (descriptor.Number() < 0 || (fsync(descriptor.Number()) != 0 && errno != EINVAL)) {
    const RuntimeError error = FileError(errno, path);
    throw RuntimeError(error.Number(),
                       error.what() + std::string(" (done, but a power failure may undo it)"));
  }
}

// A regular file that is open for reading.
struct RegularFile {
  // Throws as Files::Read does.
  explicit RegularFile(const std::string& path)
      : Handle(open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK)) {
    if (Handle.Number() < 0 && (errno == ENOENT || errno == ENOTDIR)) {
      throw RuntimeError(Fault::FileNotFound, "File not found: " + path);
    }
    struct stat info {};
    if (Handle.Number() < 0 || fstat(Handle.Number(), &info) != 0 || !S_ISREG(info.st_mode)) {
      throw RuntimeError(Fault::PathAccess, "Path/File access error: " + path);
    }
    Size = static_cast<std::size_t>(info.st_size);
  }

  // Appends what follows, at most `count` bytes, to `bytes`.
  void AppendUpTo(std::size_t count, std::string& bytes, const std::string& path) const {
    std::array<char, 65536> buffer;
    while (count > 0) {
      const ssize_t got = read(Handle.Number(), buffer.data(), std::min(buffer.size(), count));
      if (got == 0) {
        return;
      }
      if (got < 0 && errno != EINTR) {
        throw RuntimeError(Fault::PathAccess, "Path/File access error: " + path);
      }
      const std::size_t taken = got < 0 ? 0 : static_cast<std::size_t>(got);
      bytes.append(buffer.data(), taken);
      count -= taken;
    }
  }

  Descriptor Handle;
  std::size_t Size = 0;
};

enum class Readers { AsBefore, ThisUser };

void ReplaceFile(const std::string& path, const std::string& bytes, Readers readers) {
  const std::string target = FollowLinks(path);
  struct stat old {};
  const bool exists = stat(target.c_str(), &old) == 0;
  if (exists && !S_ISREG(old.st_mode)) {
    throw FileError(EISDIR, path);
  }
  if (exists && faccessat(AT_FDCWD, target.c_str(), W_OK, AT_EACCESS) != 0) {
    throw FileError(errno, path);
  }
  const std::string parent = std::filesystem::path(target).parent_path();
  const std::string folder = parent.empty() ? "." : parent;

  const bool isPrivate = readers == Readers::ThisUser;
  TemporaryFile file(folder, isPrivate ? 0600 : 0644);
  if (file.Number() < 0 || (exists && !isPrivate && !TakeOver(file.Number(), old)) ||
      !WriteAll(file.Number(), bytes) || fsync(file.Number()) != 0 || !file.RenameTo(target)) {
    throw FileError(errno, path);
  }
  SyncRename(folder, path);
}

}  // namespace

bool LinuxFiles::FileExists(const std::string& path) const {
  struct stat info {};
  if (stat(path.c_str(), &info) == 0) {
    return !S_ISDIR(info.st_mode);
  }
  // "No" has a default file put in its place, so it must be certain.
  const bool isCertain = errno == ENOENT || errno == ENOTDIR || errno == ENAMETOOLONG || errno == ELOOP;
  if (!isCertain) {
    throw FileError(errno, path);
  }
  return false;
}

bool LinuxFiles::FolderExists(const std::string& path) const {
  struct stat info {};
  return stat(path.c_str(), &info) == 0 && S_ISDIR(info.st_mode);
}

void LinuxFiles::CreateFolder(const std::string& path) {
  if (mkdir(path.c_str(), 0777) != 0) {
    if (errno == ENOENT || errno == ENOTDIR) {
      throw RuntimeError(Fault::PathNotFound, "Path not found: " + path);
    }
    throw RuntimeError(Fault::PathAccess, "Path/File access error: " + path);
  }
}

std::uint64_t LinuxFiles::FileLen(const std::string& path) const {
  struct stat info {};
  if (stat(path.c_str(), &info) != 0 && (errno == ENOENT || errno == ENOTDIR)) {
    throw RuntimeError(Fault::FileNotFound, "File not found: " + path);
  }
  if (!S_ISREG(info.st_mode) || faccessat(AT_FDCWD, path.c_str(), R_OK, AT_EACCESS) != 0) {
    throw RuntimeError(Fault::PathAccess, "Path/File access error: " + path);
  }
  return static_cast<std::uint64_t>(info.st_size);
}

std::string LinuxFiles::Read(const std::string& path) const {
  const RegularFile file(path);
  std::string bytes;
  bytes.reserve(file.Size);
  file.AppendUpTo(std::numeric_limits<std::size_t>::max(), bytes, path);
  return bytes;
}

std::string LinuxFiles::ReadPart(const std::string& path, std::uint64_t offset, std::size_t count) const {
  const RegularFile file(path);
  std::string bytes;
  if (offset < file.Size) {
    bytes.reserve(std::min<std::size_t>(count, file.Size - offset));
    if (offset > 0 && lseek(file.Handle.Number(), static_cast<off_t>(offset), SEEK_SET) < 0) {
      throw RuntimeError(Fault::PathAccess, "Path/File access error: " + path);
    }
    file.AppendUpTo(count, bytes, path);
  }
  return bytes;
}

void LinuxFiles::Replace(const std::string& path, const std::string& bytes) {
  ReplaceFile(path, bytes, Readers::AsBefore);
}

void LinuxFiles::ReplacePrivately(const std::string& path, const std::string& bytes) {
  ReplaceFile(path, bytes, Readers::ThisUser);
}

std::string LinuxFiles::MakeTempFileName() {
  std::error_code none;
  std::string path = std::filesystem::temp_directory_path(none) / "perXXXXXX";
  const Descriptor file(mkostemp(path.data(), O_CLOEXEC));
  if (file.Number() < 0) {
    throw FileError(errno, path);
  }
  return path;
}

void LinuxFiles::Write(const std::string& path, const std::string& bytes) {
  const Descriptor file(open(path.c_str(), O_WRONLY | O_CREAT | O_TRUNC | O_CLOEXEC | O_NONBLOCK, 0644));
  if (file.Number() < 0 || !WriteAll(file.Number(), bytes)) {
    throw FileError(errno, path);
  }
}

void LinuxFiles::Append(const std::string& path, const std::string& bytes) {
  const Descriptor file(open(path.c_str(), O_WRONLY | O_CREAT | O_APPEND | O_CLOEXEC | O_NONBLOCK, 0644));
  struct stat info {};
  if (file.Number() < 0 || fstat(file.Number(), &info) != 0) {
    throw FileError(errno, path);
  }
  if (!S_ISREG(info.st_mode)) {
    throw FileError(EISDIR, path);
  }
  if (!WriteAll(file.Number(), bytes)) {
    throw FileError(errno, path);
  }
}

std::uint64_t LinuxFiles::FreeSpace(const std::string& path) const {
  std::error_code error;
  const std::filesystem::space_info space = std::filesystem::space(path, error);
  if (error) {
    throw FileError(error.value(), path);
  }
  return space.available;
}

std::vector<std::string> LinuxFiles::FileNames(const std::string& folder) const {
  std::vector<std::string> names;
  std::error_code none;
  for (std::filesystem::directory_iterator entry(folder, none), end; entry != end; entry.increment(none)) {
    if (!entry->is_directory(none)) {
      names.push_back(entry->path().filename());
    }
  }
  std::sort(names.begin(), names.end());
  return names;
}

void LinuxFiles::Rename(const std::string& path, const std::string& newPath) {
  if (!FileExists(path)) {
    throw RuntimeError(Fault::FileNotFound, "File not found: " + path);
  }
  const std::string parent = std::filesystem::path(newPath).parent_path();
  if (rename(path.c_str(), newPath.c_str()) != 0) {
    throw FileError(errno, newPath);
  }
  SyncRename(parent.empty() ? "." : parent, newPath);
}

void LinuxFiles::TakePlace(const std::string& path, const std::string& replaced) {
  struct stat old {};
  if (stat(replaced.c_str(), &old) != 0) {
    throw errno == ENOENT ? RuntimeError(Fault::FileNotFound, "File not found: " + replaced)
                          : FileError(errno, replaced);
  }
  if (faccessat(AT_FDCWD, replaced.c_str(), W_OK, AT_EACCESS) != 0) {
    throw FileError(errno, replaced);
  }
  {
    const Descriptor file(open(path.c_str(), O_RDONLY | O_CLOEXEC));
    if (file.Number() < 0 || !TakeOver(file.Number(), old) || fsync(file.Number()) != 0) {
      throw errno == ENOENT ? RuntimeError(Fault::FileNotFound, "File not found: " + path)
                            : FileError(errno, path);
    }
  }
  if (rename(path.c_str(), replaced.c_str()) != 0) {
    throw FileError(errno, replaced);
  }
  SyncRename(std::filesystem::path(replaced).parent_path(), replaced);
}

void LinuxFiles::Delete(const std::string& path) {
  if (unlink(path.c_str()) != 0) {
    throw errno == ENOENT ? RuntimeError(Fault::FileNotFound, "File not found: " + path)
                          : FileError(errno, path);
  }
}
