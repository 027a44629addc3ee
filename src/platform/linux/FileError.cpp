#include "platform/linux/FileError.h"

#include <cerrno>

RuntimeError FileError(int errorNumber, const std::string& path) {
  switch (errorNumber) {
    case ENOSPC:
    case EDQUOT:
      return {Fault::DiskFull, "Disk full: " + path};
    case EACCES:
    case EPERM:
    case EROFS:
      return {Fault::PermissionDenied, "Permission denied: " + path};
    case ENOENT:
    case ENOTDIR:
      return {Fault::PathNotFound, "Path not found: " + path};
    default:
      return {Fault::PathAccess, "Path/File access error: " + path};
  }
}
