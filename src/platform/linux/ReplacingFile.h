#pragma once

#include <sys/stat.h>

#include <memory>
#include <string>
#include <string_view>

#include "platform/Files.h"

/// A file that is written under another name beside the one whose place it takes. All throw as Files::Replace
/// does.
class ReplacingFile : public NewFile {
 public:
  ReplacingFile(const std::string& path, FileReaders readers);
  ~ReplacingFile() override;
  ReplacingFile(const ReplacingFile&) = delete;
  ReplacingFile& operator=(const ReplacingFile&) = delete;

  void Write(std::string_view bytes) override;
  void Finish() override;

 private:
  class TemporaryFile;

  const std::string path_;
  const std::string target_;  ///< the path behind its symbolic links
  const std::string folder_;
  std::unique_ptr<TemporaryFile> file_;
};

/// The path of a hidden file in `folder` with a random name, for one that is written and then renamed.
std::string NewNameIn(const std::string& folder);
/// True for the names that such files have until they are finished.
bool IsUnfinishedName(std::string_view name);

/// Writes all of the bytes. Returns false, with errno, if that fails.
bool WriteAll(int file, std::string_view bytes);

/// Gives the new file the old one's permissions and, where allowed, its owner. Returns false, with errno, if
/// that fails.
bool TakeOver(int file, const struct stat& old);

/// Makes it durable that `path` now names a file which was renamed to it, in `folder`. File systems that do
/// not support this (EINVAL) count as done. The error says that the file is in its place all the same.
void SyncRename(const std::string& folder, const std::string& path);
