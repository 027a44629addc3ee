#include "core/data/LogRing.h"

#include <utility>

#include "platform/RuntimeError.h"

LogRing::LogRing(Files& files, std::string folder, const std::string& name, std::uint64_t mostBytes)
    : files_(files),
      folder_(std::move(folder)),
      path_(folder_ + '/' + name + ".log"),
      olderPath_(folder_ + '/' + name + ".1.log"),
      mostBytes_(mostBytes) {}

void LogRing::Append(const std::string& rows) {
  if (rows.empty()) {
    return;
  }
  try {
    Write(rows);
  } catch (const RuntimeError&) {
    size_.reset();  // whatever happened to the file, look at it again next time
  }
}

void LogRing::Write(const std::string& rows) {
  if (!files_.FolderExists(folder_)) {
    files_.CreateFolder(folder_);
  }
  if (files_.FreeSpace(folder_) < FreeBytesKept + rows.size()) {
    return;
  }
  if (!size_) {
    size_ = files_.FileExists(path_) ? files_.FileLen(path_) : 0;
  }
  if (*size_ > 0 && *size_ + rows.size() > mostBytes_) {
    files_.Rename(path_, olderPath_);
    size_ = 0;
  }
  files_.Append(path_, rows);
  *size_ += rows.size();
}
