#include "platform/linux/InstanceSocket.h"

#include <fcntl.h>

#include <cstring>
#include <filesystem>

InstanceAddress::InstanceAddress(const std::string& path) {
  address_.sun_family = AF_UNIX;
  std::string shortPath = path;
  if (path.size() >= sizeof(address_.sun_path)) {
    const std::filesystem::path whole(path);
    folder_ = Descriptor(open(whole.parent_path().c_str(), O_PATH | O_DIRECTORY | O_CLOEXEC));
    if (folder_.Number() < 0) {
      return;
    }
    shortPath = "/proc/self/fd/" + std::to_string(folder_.Number()) + "/" + whole.filename().string();
  }
  if (shortPath.size() < sizeof(address_.sun_path)) {
    std::memcpy(static_cast<char*>(address_.sun_path), shortPath.c_str(), shortPath.size() + 1);
    valid_ = true;
  }
}

bool IsOfThisUser(int socket) {
  ucred peer{};
  socklen_t size = sizeof(peer);
  return getsockopt(socket, SOL_SOCKET, SO_PEERCRED, &peer, &size) == 0 && size == sizeof(peer) &&
         peer.uid == geteuid();
}
