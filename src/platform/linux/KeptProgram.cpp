#include "platform/linux/KeptProgram.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <utility>

KeptProgram::KeptProgram(std::string name)
    : name_(std::move(name)), held_(open(name_.c_str(), O_PATH | O_CLOEXEC)) {}

std::string KeptProgram::Path() const {
  struct stat kept {};
  struct stat there {};
  if (held_.Number() < 0 || fstat(held_.Number(), &kept) != 0) {
    return name_;
  }
  const bool same =
      stat(name_.c_str(), &there) == 0 && there.st_dev == kept.st_dev && there.st_ino == kept.st_ino;
  // Not /proc/self: a child looks it up, in which descriptors are closed already.
  return same ? name_ : "/proc/" + std::to_string(getpid()) + "/fd/" + std::to_string(held_.Number());
}
