#pragma once

#include <string>

#include "platform/Files.h"

/// Files of the local file system. Only regular files are read and replaced, so that a pipe or a device
/// cannot block the program.
class LinuxFiles : public Files {
 public:
  bool FileExists(const std::string& path) const override;
  bool FolderExists(const std::string& path) const override;
  void CreateFolder(const std::string& path) override;
  void MakePrivateFolder(const std::string& path) override;
  void DeleteUnfinished(const std::string& folder) override;
  std::uint64_t FileLen(const std::string& path) const override;
  std::string Read(const std::string& path) const override;
  std::string ReadPart(const std::string& path, std::uint64_t offset, std::size_t count) const override;

  /// Keeps the old file's permissions, and its owner where that is allowed; a new file gets 0644 less the
  /// umask. A write-protected file is refused (70), even where its folder would allow replacing it.
  void Replace(const std::string& path, const std::string& bytes) override;
  void ReplacePrivately(const std::string& path, const std::string& bytes) override;
  std::unique_ptr<NewFile> BeginReplace(const std::string& path, FileReaders readers) override;
  std::string MakeTempFileName() override;
  /// It gets 0644 less the umask.
  std::string MakeFileIn(const std::string& folder) override;
  void Write(const std::string& path, const std::string& bytes) override;
  void Append(const std::string& path, const std::string& bytes) override;
  std::uint64_t FreeSpace(const std::string& path) const override;
  bool IsSame(const std::string& path, const std::string& other) const override;
  std::vector<std::string> FileNames(const std::string& folder) const override;
  std::vector<std::string> FolderNames(const std::string& folder) const override;
  std::string TimeOfChange(const std::string& path) const override;
  void Rename(const std::string& path, const std::string& newPath) override;
  void TakePlace(const std::string& path, const std::string& replaced) override;
  void Delete(const std::string& path) override;
};
