#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

/// Who may read a file that is written anew.
enum class FileReaders {
  AsBefore,
  ThisUser  ///< nobody else, also where others could read the file before
};

/// A file in the making. It takes its place only when it is whole; until then, and if that never comes, what
/// was there before stays, and nothing is left behind.
class NewFile {
 public:
  virtual ~NewFile() = default;

  /// Adds bytes at the end. Throws as Files::Replace does.
  virtual void Write(std::string_view bytes) = 0;

  /// Puts the file in its place; durable on return. Nothing may be written afterwards. Throws as
  /// Files::Replace does.
  virtual void Finish() = 0;
};

/// Files and folders by path (UTF-8, the platform's separator).
class Files {
 public:
  virtual ~Files() = default;

  /// FileExists throws RuntimeError 70 or 75 when the disk or the folder's permissions do not let it tell.
  virtual bool FileExists(const std::string& path) const = 0;
  virtual bool FolderExists(const std::string& path) const = 0;

  /// Makes one folder; its parent must exist. Throws RuntimeError 75 or 76.
  virtual void CreateFolder(const std::string& path) = 0;

  /// Makes one folder that only this user may enter, or makes the one that is there such a folder; its parent
  /// must exist. Throws RuntimeError 75 or 76.
  virtual void MakePrivateFolder(const std::string& path) = 0;

  /// Size of a file in bytes. Throws RuntimeError 53 if it does not exist, 75 if it is not a readable file.
  virtual std::uint64_t FileLen(const std::string& path) const = 0;

  /// The whole file. Throws RuntimeError 53 when it does not exist, 75 when it cannot be read.
  virtual std::string Read(const std::string& path) const = 0;

  /// Up to `count` bytes from `offset` on; fewer where the file ends. Throws as Read does.
  virtual std::string ReadPart(const std::string& path, std::uint64_t offset, std::size_t count) const = 0;

  /// Writes the whole file atomically: a failure or a crash leaves the old file (or none). Durable on return.
  /// If the path is a symbolic link, its target is replaced. Throws RuntimeError 61 (disk full), 70, 75 or
  /// 76; the text names the file, and says so if the new one is in place and only its durability is in doubt.
  virtual void Replace(const std::string& path, const std::string& bytes) = 0;

  /// Does the same for personal data: this user alone may read the file, also where others could read the
  /// one before.
  virtual void ReplacePrivately(const std::string& path, const std::string& bytes) = 0;

  /// Does the same for a file that is written piece by piece. Throws as Replace does.
  virtual std::unique_ptr<NewFile> BeginReplace(const std::string& path, FileReaders readers) = 0;

  /// Deletes what a program that was killed in the middle of such a replacement left in a folder. What cannot
  /// be deleted stays. Only where no other program of this kind can be at work in the folder.
  virtual void DeleteUnfinished(const std::string& folder) = 0;

  /// Creates an empty file in the system's temporary folder, its name beginning with "per", and returns its
  /// path. Throws as Replace does.
  virtual std::string MakeTempFileName() = 0;

  /// Creates an empty file in `folder`, hidden and under a name that no other file has, for what will then be
  /// renamed to another one there, and returns its path. Throws as Replace does.
  virtual std::string MakeFileIn(const std::string& folder) = 0;

  /// Writes the whole file in place, neither atomically nor durably: for temporary files. Throws as Replace
  /// does.
  virtual void Write(const std::string& path, const std::string& bytes) = 0;

  /// Appends bytes to a file, creating it if it is missing; not durable. Throws as Replace does.
  virtual void Append(const std::string& path, const std::string& bytes) = 0;

  /// Bytes that this user may still write on the disk that holds `path`, a file or folder. Throws
  /// RuntimeError 76 if there is no such path.
  virtual std::uint64_t FreeSpace(const std::string& path) const = 0;

  /// True if both paths lead to the same file or folder, be it by symbolic or by hard links. False if one of
  /// them leads nowhere.
  virtual bool IsSame(const std::string& path, const std::string& other) const = 0;

  /// Names of the files in a folder, in ascending order; none if there is no such folder.
  virtual std::vector<std::string> FileNames(const std::string& folder) const = 0;

  /// Names of the folders in a folder, in ascending order; symbolic links are not among them. Throws
  /// RuntimeError 70, 75 or 76 for a folder that cannot be read.
  virtual std::vector<std::string> FolderNames(const std::string& folder) const = 0;

  /// Local time at which a file was last changed, "YYYY-MM-DD HH:MM:SS". Throws RuntimeError 53 if it does
  /// not exist, 75 if it cannot be told.
  virtual std::string TimeOfChange(const std::string& path) const = 0;

  /// Moves a file to another path on the same disk, replacing any file there. Durable on return. Throws
  /// RuntimeError 53 if it does not exist, 61, 70, 75 or 76, with a text as that of Replace.
  virtual void Rename(const std::string& path, const std::string& newPath) = 0;

  /// Puts the file at `path` in the place of `replaced`, a file on the same disk: it gets that one's
  /// permissions and, where allowed, its owner. A failure or a crash leaves the old file. Durable on return.
  /// Neither may be a symbolic link. Throws as Rename does, and RuntimeError 70 if the old file is
  /// write-protected.
  virtual void TakePlace(const std::string& path, const std::string& replaced) = 0;

  /// Deletes a file. Throws RuntimeError 53 if it does not exist, 70, 75 or 76.
  virtual void Delete(const std::string& path) = 0;
};
