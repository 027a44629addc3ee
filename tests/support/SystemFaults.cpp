#include "tests/support/SystemFaults.h"

#include <fcntl.h>
#include <sys/sendfile.h>
#include <sys/stat.h>
#include <sys/syscall.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <cstdarg>
#include <cstdio>
#include <stdexcept>
#include <string_view>
#include <utility>

namespace {

SystemFaults* Active = nullptr;

std::string PathOf(int descriptor) {
  const std::string link = "/proc/self/fd/" + std::to_string(descriptor);
  std::array<char, 4096> path{};
  const ssize_t size = readlink(link.c_str(), path.data(), path.size());
  return size < 0 ? std::string() : std::string(path.data(), static_cast<std::size_t>(size));
}

const char* NameOf(FileCall call) {
  switch (call) {
    case FileCall::Open:
      return "Open";
    case FileCall::Create:
      return "Create";
    case FileCall::Status:
      return "Status";
    case FileCall::Read:
      return "Read";
    case FileCall::Write:
      return "Write";
    case FileCall::Flush:
      return "Flush";
    case FileCall::FlushFolder:
      return "FlushFolder";
    case FileCall::Truncate:
      return "Truncate";
    case FileCall::Rename:
      return "Rename";
    case FileCall::Link:
      return "Link";
    case FileCall::Delete:
      return "Delete";
    case FileCall::MakeFolder:
      return "MakeFolder";
    case FileCall::Lock:
      return "Lock";
  }
  return "";
}

/// Makes the system call, or fails in its place.
template <typename Call>
long Answer(SystemFaults* faults, FileCall kind, const std::string& path, const Call& call) {
  if (faults == nullptr || !faults->Fails(kind, path)) {
    return call();
  }
  if (faults->Fault().What == FileFault::Effect::Whole) {
    call();
  }
  errno = faults->Fault().Error;
  return -1;
}

template <typename Call>
long AnswerOnPath(FileCall kind, const char* path, const Call& call) {
  SystemFaults* const faults = SystemFaults::OnPath(path);
  return Answer(faults, kind, faults == nullptr ? std::string() : path, call);
}

template <typename Call>
long AnswerOnFile(FileCall kind, int file, const Call& call) {
  SystemFaults* const faults = SystemFaults::OnFile(file);
  return Answer(faults, kind, faults == nullptr ? std::string() : PathOf(file), call);
}

/// The same for reads and writes of `size` bytes, which may also be cut short.
template <typename Call>
ssize_t AnswerTransfer(FileCall kind, int file, std::size_t size, const Call& call) {
  SystemFaults* const faults = SystemFaults::OnFile(file);
  if (faults != nullptr && faults->Fault().What == FileFault::Effect::Half) {
    return call(size > 1 && faults->Fails(kind, PathOf(file)) ? size / 2 : size);
  }
  return Answer(faults, kind, faults == nullptr ? std::string() : PathOf(file), [&] { return call(size); });
}

int OpenFile(int folder, const char* path, int flags, mode_t mode) {
  const FileCall kind = (flags & O_CREAT) != 0 ? FileCall::Create : FileCall::Open;
  return static_cast<int>(
      AnswerOnPath(kind, path, [&] { return syscall(SYS_openat, folder, path, flags, mode); }));
}

mode_t ModeIn(va_list arguments, int flags) {
  return (flags & (O_CREAT | O_TMPFILE)) != 0 ? va_arg(arguments, mode_t) : 0;
}

int FlushFile(int file) {
  SystemFaults* const faults = SystemFaults::OnFile(file);
  if (faults == nullptr) {
    return static_cast<int>(syscall(SYS_fsync, file));
  }
  const std::string path = PathOf(file);
  struct stat info {};
  const bool isFolder = syscall(SYS_fstat, file, &info) == 0 && S_ISDIR(info.st_mode);
  return static_cast<int>(
      Answer(faults, isFolder ? FileCall::FlushFolder : FileCall::Flush, path, [] { return 0L; }));
}

int LockOrOther(int file, int command, void* argument) {
  const auto call = [&] { return syscall(SYS_fcntl, file, command, argument); };
  const bool locks =
      (command == F_SETLK || command == F_SETLKW) && static_cast<struct flock*>(argument)->l_type != F_UNLCK;
  return static_cast<int>(locks ? AnswerOnFile(FileCall::Lock, file, call) : call());
}

}  // namespace

SystemFaults::SystemFaults(std::string folder, const FileFault& fault)
    : SystemFaults(std::move(folder), fault, 0, Lasting::Once) {}

SystemFaults::SystemFaults(std::string folder, const FileFault& fault, int first, Lasting lasting)
    : folder_(std::move(folder)), fault_(fault), first_(first), lasting_(lasting) {
  if (Active != nullptr) {
    throw std::logic_error("Faults do not nest");
  }
  Active = this;
}

SystemFaults::~SystemFaults() {
  Active = nullptr;
}

SystemFaults* SystemFaults::OnPath(const char* path) {
  if (Active == nullptr || path == nullptr) {
    return nullptr;
  }
  const std::string_view name(path);
  const std::string& folder = Active->folder_;
  const bool isIn = name.starts_with(folder) && (name.size() == folder.size() || name[folder.size()] == '/');
  return isIn ? Active : nullptr;
}

SystemFaults* SystemFaults::OnFile(int descriptor) {
  return Active == nullptr ? nullptr : OnPath(PathOf(descriptor).c_str());
}

bool SystemFaults::Fails(FileCall call, const std::string& path) {
  if ((fault_.Calls & Only(call)) == 0) {
    return false;
  }
  ++calls_;
  const bool fails = lasting_ == Lasting::Once ? calls_ == first_ : Failed();
  if (fails && failedCall_.empty()) {
    failedCall_ = std::string(NameOf(call)) + " " + path.substr(path.rfind('/') + 1);
  }
  return fails;
}

const std::vector<FileFault>& AllFileFaults() {
  static const std::uint32_t changes = FileCall::Create | FileCall::Write | FileCall::Truncate |
                                       FileCall::Rename | FileCall::Link | FileCall::MakeFolder;
  static const std::uint32_t all = changes | FileCall::Open | FileCall::Status | FileCall::Read |
                                   FileCall::Flush | FileCall::FlushFolder | FileCall::Delete |
                                   FileCall::Lock;
  static const std::vector<FileFault> faults = {
      {"EIO", all, EIO},
      {"EIO after the call took effect",
       FileCall::Flush | FileCall::FlushFolder | FileCall::Truncate | FileCall::Rename | FileCall::Delete,
       EIO, FileFault::Effect::Whole},
      {"ENOSPC", changes | FileCall::Flush, ENOSPC},
      {"EDQUOT", changes | FileCall::Flush, EDQUOT},
      {"EINVAL of the folder flush", Only(FileCall::FlushFolder), EINVAL},
      {"short read or write", FileCall::Read | FileCall::Write, 0, FileFault::Effect::Half},
      {"locked by another program", Only(FileCall::Lock), EAGAIN},
      {"no permission",
       FileCall::Open | FileCall::Create | FileCall::Status | FileCall::Rename | FileCall::Link |
           FileCall::Delete | FileCall::MakeFolder,
       EACCES},
  };
  return faults;
}

extern "C" {

int open(const char* path, int flags, ...) {
  va_list arguments;
  va_start(arguments, flags);
  const mode_t mode = ModeIn(arguments, flags);
  va_end(arguments);
  return OpenFile(AT_FDCWD, path, flags, mode);
}

int open64(const char* path, int flags, ...) {
  va_list arguments;
  va_start(arguments, flags);
  const mode_t mode = ModeIn(arguments, flags);
  va_end(arguments);
  return OpenFile(AT_FDCWD, path, flags, mode);
}

int stat(const char* path, struct stat* info) noexcept {
  return static_cast<int>(
      AnswerOnPath(FileCall::Status, path, [&] { return syscall(SYS_newfstatat, AT_FDCWD, path, info, 0); }));
}

int stat64(const char* path, struct stat64* info) noexcept {
  return static_cast<int>(
      AnswerOnPath(FileCall::Status, path, [&] { return syscall(SYS_newfstatat, AT_FDCWD, path, info, 0); }));
}

ssize_t read(int file, void* bytes, std::size_t size) {
  return AnswerTransfer(FileCall::Read, file, size,
                        [&](std::size_t count) { return syscall(SYS_read, file, bytes, count); });
}

ssize_t pread(int file, void* bytes, std::size_t size, off_t offset) {
  return AnswerTransfer(FileCall::Read, file, size,
                        [&](std::size_t count) { return syscall(SYS_pread64, file, bytes, count, offset); });
}

ssize_t pread64(int file, void* bytes, std::size_t size, off64_t offset) {
  return pread(file, bytes, size, offset);
}

ssize_t write(int file, const void* bytes, std::size_t size) {
  return AnswerTransfer(FileCall::Write, file, size,
                        [&](std::size_t count) { return syscall(SYS_write, file, bytes, count); });
}

ssize_t pwrite(int file, const void* bytes, std::size_t size, off_t offset) {
  return AnswerTransfer(FileCall::Write, file, size,
                        [&](std::size_t count) { return syscall(SYS_pwrite64, file, bytes, count, offset); });
}

ssize_t pwrite64(int file, const void* bytes, std::size_t size, off64_t offset) {
  return pwrite(file, bytes, size, offset);
}

ssize_t sendfile(int to, int from, off_t* offset, std::size_t size) noexcept {
  return AnswerTransfer(FileCall::Write, to, size,
                        [&](std::size_t count) { return syscall(SYS_sendfile, to, from, offset, count); });
}

int fsync(int file) {
  return FlushFile(file);
}

int fdatasync(int file) {
  return FlushFile(file);
}

int ftruncate(int file, off_t size) noexcept {
  return static_cast<int>(
      AnswerOnFile(FileCall::Truncate, file, [&] { return syscall(SYS_ftruncate, file, size); }));
}

int ftruncate64(int file, off64_t size) noexcept {
  return ftruncate(file, size);
}

int rename(const char* path, const char* newPath) noexcept {
  return static_cast<int>(
      AnswerOnPath(FileCall::Rename, newPath, [&] { return syscall(SYS_rename, path, newPath); }));
}

int link(const char* path, const char* newPath) noexcept {
  return static_cast<int>(
      AnswerOnPath(FileCall::Link, newPath, [&] { return syscall(SYS_link, path, newPath); }));
}

int unlink(const char* path) noexcept {
  return static_cast<int>(AnswerOnPath(FileCall::Delete, path, [&] { return syscall(SYS_unlink, path); }));
}

int mkdir(const char* path, mode_t mode) noexcept {
  return static_cast<int>(
      AnswerOnPath(FileCall::MakeFolder, path, [&] { return syscall(SYS_mkdir, path, mode); }));
}

int fcntl(int file, int command, ...) {
  va_list arguments;
  va_start(arguments, command);
  void* const argument = va_arg(arguments, void*);
  va_end(arguments);
  return LockOrOther(file, command, argument);
}

int fcntl64(int file, int command, ...) {
  va_list arguments;
  va_start(arguments, command);
  void* const argument = va_arg(arguments, void*);
  va_end(arguments);
  return LockOrOther(file, command, argument);
}

}  // extern "C"
