#include "sim/line/OpenWatch.h"

#include <sys/inotify.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <system_error>

namespace sim {

OpenWatch::OpenWatch(const std::string& path) : events_(::inotify_init1(IN_CLOEXEC | IN_NONBLOCK)) {
  if (!events_.IsOpen() || ::inotify_add_watch(events_.Get(), path.c_str(), IN_OPEN) < 0) {
    throw std::system_error(errno, std::generic_category(), path);
  }
}

bool OpenWatch::TakeOpening() {
  // The watch is for openings only, so each event is one; the file itself has no name in them.
  std::array<char, 4096> events{};
  bool opened = false;
  while (::read(events_.Get(), events.data(), events.size()) > 0) {
    opened = true;
  }
  return opened;
}

}  // namespace sim
