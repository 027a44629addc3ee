#pragma once

#include <cstddef>
#include <cstdint>
#include <map>
#include <memory>
#include <set>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "platform/Files.h"
#include "platform/RuntimeError.h"

/// Files and folders in memory. The root always exists.
class FakeFiles : public Files {
 public:
  struct ReplaceCall {
    std::string Path;
    std::string Bytes;

    bool operator==(const ReplaceCall&) const = default;
  };

  /// All calls of Replace, including those that failed.
  std::vector<ReplaceCall> Replaced;

  /// All calls of CreateFolder, including those that failed.
  std::vector<std::string> Created;

  /// Number of calls of Append, including those that failed.
  int Appends = 0;

  /// What FreeSpace returns.
  std::uint64_t FreeBytes = std::uint64_t{1} << 40U;

  /// Adds a folder and its parents.
  void AddFolder(const std::string& path) {
    for (std::string folder = path; !FolderExists(folder); folder = ParentOf(folder)) {
      folders_.insert(WithoutSeparator(folder));
    }
  }

  /// Adds or changes a file, with its folders.
  void Put(const std::string& path, const std::string& bytes) {
    AddFolder(ParentOf(path));
    contents_[path] = bytes;
  }

  void Remove(const std::string& path) { contents_.erase(path); }

  const std::map<std::string, std::string>& Contents() const { return contents_; }

  /// From now on every read, replacement (also Write, Append, Rename), creation or deletion of `path` fails.
  void FailRead(const std::string& path, const RuntimeError& error) {
    readFailures_.insert_or_assign(path, error);
  }
  void FailReplace(const std::string& path, const RuntimeError& error) {
    replaceFailures_.insert_or_assign(path, error);
  }
  void FailCreateFolder(const std::string& path, const RuntimeError& error) {
    createFailures_.insert_or_assign(path, error);
  }

  void FailDelete(const std::string& path, const RuntimeError& error) {
    deleteFailures_.insert_or_assign(path, error);
  }

  /// Where MakeTempFileName creates "per1", "per2", ...; it fails after FailCreateFolder for this folder.
  static constexpr const char* TempFolder = "/tmp";

  bool FileExists(const std::string& path) const override { return contents_.count(path) != 0; }

  bool FolderExists(const std::string& path) const override {
    const std::string name = WithoutSeparator(path);
    return name.empty() || folders_.count(name) != 0;
  }

  /// The folders for which DeleteUnfinished was called.
  std::vector<std::string> Tidied;

  void DeleteUnfinished(const std::string& folder) override { Tidied.push_back(folder); }

  void MakePrivateFolder(const std::string& path) override {
    if (!FolderExists(path)) {
      CreateFolder(path);
    }
  }

  void CreateFolder(const std::string& path) override {
    Created.push_back(path);
    ThrowIfTold(createFailures_, path);
    if (!FolderExists(ParentOf(path))) {
      throw RuntimeError(Fault::PathNotFound);
    }
    if (FolderExists(path) || FileExists(WithoutSeparator(path))) {
      throw RuntimeError(Fault::PathAccess);
    }
    folders_.insert(WithoutSeparator(path));
  }

  std::uint64_t FileLen(const std::string& path) const override { return Read(path).size(); }

  std::string Read(const std::string& path) const override {
    ThrowIfTold(readFailures_, path);
    const auto file = contents_.find(path);
    if (file == contents_.end()) {
      throw RuntimeError(FolderExists(path) ? 75 : 53);
    }
    return file->second;
  }

  std::string ReadPart(const std::string& path, std::uint64_t offset, std::size_t count) const override {
    const std::string bytes = Read(path);
    return offset < bytes.size() ? bytes.substr(static_cast<std::size_t>(offset), count) : std::string();
  }

  void Replace(const std::string& path, const std::string& bytes) override {
    Replaced.push_back({path, bytes});
    ThrowIfTold(replaceFailures_, path);
    if (!FolderExists(ParentOf(path))) {
      throw RuntimeError(Fault::PathNotFound, "Path not found: " + path);
    }
    if (FolderExists(path)) {
      throw RuntimeError(Fault::PathAccess, "Path/File access error: " + path);
    }
    contents_[path] = bytes;
  }

  /// The paths of ReplacePrivately, each of them in Replaced as well.
  std::vector<std::string> Private;

  void ReplacePrivately(const std::string& path, const std::string& bytes) override {
    Private.push_back(path);
    Replace(path, bytes);
  }

  std::unique_ptr<NewFile> BeginReplace(const std::string& path, FileReaders readers) override {
    ThrowIfTold(replaceFailures_, path);
    return std::make_unique<FileInTheMaking>(*this, path, readers);
  }

  std::string MakeTempFileName() override {
    ThrowIfTold(createFailures_, TempFolder);
    std::string path = std::string(TempFolder) + "/per" + std::to_string(++tempFiles_);
    Put(path, "");
    return path;
  }

  std::string MakeFileIn(const std::string& folder) override {
    std::string path = folder + "/.new-" + std::to_string(++tempFiles_);
    ThrowIfTold(createFailures_, folder);
    Put(path, "");
    return path;
  }

  void Write(const std::string& path, const std::string& bytes) override {
    ThrowIfTold(replaceFailures_, path);
    contents_[path] = bytes;
  }

  void Append(const std::string& path, const std::string& bytes) override {
    ++Appends;
    ThrowIfTold(replaceFailures_, path);
    if (!FolderExists(ParentOf(path))) {
      throw RuntimeError(Fault::PathNotFound, "Path not found: " + path);
    }
    if (FolderExists(path)) {
      throw RuntimeError(Fault::PathAccess, "Path/File access error: " + path);
    }
    contents_[path] += bytes;
  }

  std::uint64_t FreeSpace(const std::string& path) const override {
    if (!FileExists(path) && !FolderExists(path)) {
      throw RuntimeError(Fault::PathNotFound, "Path not found: " + path);
    }
    return FreeBytes;
  }

  bool IsSame(const std::string& path, const std::string& other) const override {
    return (FileExists(path) || FolderExists(path)) && WithoutSeparator(path) == WithoutSeparator(other);
  }

  std::vector<std::string> FileNames(const std::string& folder) const override {
    std::vector<std::string> names;
    for (const auto& [path, bytes] : contents_) {
      if (ParentOf(path) == WithoutSeparator(folder)) {
        names.push_back(path.substr(path.rfind('/') + 1));
      }
    }
    return names;
  }

  std::vector<std::string> FolderNames(const std::string& folder) const override {
    ThrowIfTold(readFailures_, folder);
    std::vector<std::string> names;
    for (const std::string& path : folders_) {
      if (ParentOf(path) == WithoutSeparator(folder)) {
        names.push_back(path.substr(path.rfind('/') + 1));
      }
    }
    return names;
  }

  /// What TimeOfChange returns for each file that is there.
  std::string ChangeTime = "2013-05-21 12:00:00";

  std::string TimeOfChange(const std::string& path) const override {
    Read(path);
    return ChangeTime;
  }

  void Rename(const std::string& path, const std::string& newPath) override {
    ThrowIfTold(replaceFailures_, newPath);
    if (!FileExists(path)) {
      throw RuntimeError(Fault::FileNotFound);
    }
    contents_[newPath] = contents_[path];
    contents_.erase(path);
  }

  void TakePlace(const std::string& path, const std::string& replaced) override {
    if (!FileExists(replaced)) {
      throw RuntimeError(Fault::FileNotFound);
    }
    Rename(path, replaced);
  }

  void Delete(const std::string& path) override {
    ThrowIfTold(deleteFailures_, path);
    if (contents_.erase(path) == 0) {
      throw RuntimeError(Fault::FileNotFound);
    }
  }

 private:
  class FileInTheMaking : public NewFile {
   public:
    FileInTheMaking(FakeFiles& disk, std::string path, FileReaders readers)
        : disk_(disk), path_(std::move(path)), readers_(readers) {}

    void Write(std::string_view bytes) override { bytes_.append(bytes); }
    void Finish() override {
      if (readers_ == FileReaders::ThisUser) {
        disk_.ReplacePrivately(path_, bytes_);
      } else {
        disk_.Replace(path_, bytes_);
      }
    }

   private:
    FakeFiles& disk_;
    const std::string path_;
    const FileReaders readers_;
    std::string bytes_;
  };

  using Failures = std::map<std::string, RuntimeError>;

  static void ThrowIfTold(const Failures& failures, const std::string& path) {
    if (const auto failure = failures.find(path); failure != failures.end()) {
      throw failure->second;
    }
  }

  static std::string WithoutSeparator(std::string path) {
    while (!path.empty() && path.back() == '/') {
      path.pop_back();
    }
    return path;
  }

  static std::string ParentOf(const std::string& path) {
    const std::string name = WithoutSeparator(path);
    const auto separator = name.rfind('/');
    return separator == std::string::npos ? std::string() : name.substr(0, separator);
  }

  std::map<std::string, std::string> contents_;
  std::set<std::string> folders_;
  Failures readFailures_;
  Failures replaceFailures_;
  Failures createFailures_;
  Failures deleteFailures_;
  int tempFiles_ = 0;
};
