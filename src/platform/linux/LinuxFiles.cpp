#include "platform/linux/LinuxFiles.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>
#include <cerrno>
#include <cstdio>
#include <ctime>

#include <algorithm>
#include <array>
#include <filesystem>
#include <limits>
#include <string_view>

#include "platform/linux/Descriptor.h"
#include "platform/linux/FileError.h"
#include "platform/linux/ReplacingFile.h"

namespace {

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

void ReplaceFile(const std::string& path, const std::string& bytes, FileReaders readers) {
  ReplacingFile file(path, readers);
  file.Write(bytes);
  file.Finish();
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

void LinuxFiles::MakePrivateFolder(const std::string& path) {
  if (!FolderExists(path)) {
    CreateFolder(path);
  }
  if (chmod(path.c_str(), 0700) != 0) {
    throw RuntimeError(Fault::PathAccess, "Path/File access error: " + path);
  }
}

void LinuxFiles::DeleteUnfinished(const std::string& folder) {
  for (const std::string& name : FileNames(folder)) {
    if (IsUnfinishedName(name)) {
      std::error_code none;
      std::filesystem::remove(std::string(folder).append("/").append(name), none);
    }
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
  ReplaceFile(path, bytes, FileReaders::AsBefore);
}

void LinuxFiles::ReplacePrivately(const std::string& path, const std::string& bytes) {
  ReplaceFile(path, bytes, FileReaders::ThisUser);
}

std::unique_ptr<NewFile> LinuxFiles::BeginReplace(const std::string& path, FileReaders readers) {
  return std::make_unique<ReplacingFile>(path, readers);
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

std::string LinuxFiles::MakeFileIn(const std::string& folder) {
  std::string path = NewNameIn(folder);
  const Descriptor file(open(path.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, 0644));
  if (file.Number() < 0) {
    throw FileError(errno, folder);
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

bool LinuxFiles::IsSame(const std::string& path, const std::string& other) const {
  std::error_code error;
  return std::filesystem::equivalent(path, other, error) && !error;
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

std::vector<std::string> LinuxFiles::FolderNames(const std::string& folder) const {
  std::vector<std::string> names;
  std::error_code error;
  std::filesystem::directory_iterator entry(folder, error);
  for (const std::filesystem::directory_iterator end; !error && entry != end; entry.increment(error)) {
    std::error_code none;
    if (entry->symlink_status(none).type() == std::filesystem::file_type::directory) {
      names.push_back(entry->path().filename());
    }
  }
  if (error) {
    throw FileError(error.value(), folder);
  }
  std::sort(names.begin(), names.end());
  return names;
}

std::string LinuxFiles::TimeOfChange(const std::string& path) const {
  struct stat info {};
  if (stat(path.c_str(), &info) != 0) {
    throw errno == ENOENT || errno == ENOTDIR ? RuntimeError(Fault::FileNotFound, "File not found: " + path)
                                              : FileError(errno, path);
  }
  std::array<char, 32> text{};
  struct tm local {};
  if (localtime_r(&info.st_mtime, &local) == nullptr ||
      std::strftime(text.data(), text.size(), "%Y-%m-%d %H:%M:%S", &local) == 0) {
    throw RuntimeError(Fault::PathAccess, "Path/File access error: " + path);
  }
  return text.data();
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
