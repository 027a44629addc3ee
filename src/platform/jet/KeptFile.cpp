#include "platform/jet/KeptFile.h"

#include <fcntl.h>
#include <unistd.h>

#include <filesystem>

#include "platform/RuntimeError.h"
#include "platform/linux/Descriptor.h"

namespace {

std::string Numbered(const std::string& path, int number) {
  return path + (number == 1 ? "" : std::to_string(number));
}

void SyncFolderOf(const std::string& path) {
  const std::string folder = std::filesystem::path(path).parent_path();
  const Descriptor descriptor(open(folder.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC));
  if (descriptor.Number() >= 0) {
    fsync(descriptor.Number());  // a file system that cannot do it makes names durable by itself
  }
}

}  // namespace

bool HardLink(const std::string& path, const std::string& newPath) {
  return link(path.c_str(), newPath.c_str()) == 0;
}

std::string UnusedName(const Files& disk, const std::string& path) {
  int number = 1;
  while (disk.FileExists(Numbered(path, number))) {
    ++number;
  }
  return Numbered(path, number);
}

KeptFile::KeptFile(Files& disk, const std::string& path, const LinkFile& link) : disk_(disk) {
  for (int number = 1;; ++number) {
    path_ = Numbered(path + ".jet", number);
    std::error_code error;
    if (!disk.FileExists(path_)) {
      break;
    }
    if (std::filesystem::equivalent(path_, path, error)) {
      isOurs_ = false;
      stays_ = true;
      return;
    }
  }
  if (link(path, path_)) {
    SyncFolderOf(path_);
  } else {
    disk.Replace(path_, disk.Read(path));
  }
}

KeptFile::~KeptFile() {
  if (stays_) {
    return;
  }
  try {
    disk_.Delete(path_);
  } catch (const RuntimeError&) {  // a second copy of the old file does no harm
  }
}
