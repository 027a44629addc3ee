#include "platform/linux/FileError.h"

#include <cerrno>

RuntimeError FileError(int errorNumber, const std::string& path) {
  switch (errorNumber) {
    case ENOSPC:
    case EDQUOT:
      return {61, "Disk full: " + path};
    case EACCES:
    case EPERM:
    case EROFS:
      return {70, "Permission denied: " + path};
    case ENOENT:
    case ENOTDIR:
      return {76, "Path not found: " + path};
    default:
      return {75, "Path/File access error: " + path};
  }
}
