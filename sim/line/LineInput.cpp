#include "sim/line/LineInput.h"

#include <unistd.h>

#include <array>
#include <cerrno>
#include <string_view>
#include <utility>

namespace sim {

std::vector<std::string> LineInput::Read() {
  std::array<char, 1024> buffer{};
  const ssize_t count = ::read(descriptor_, buffer.data(), buffer.size());
  std::vector<std::string> lines;
  if (count > 0) {
    for (const char next : std::string_view(buffer.data(), static_cast<std::size_t>(count))) {
      if (next == '\n') {
        lines.push_back(std::exchange(begun_, {}));
      } else {
        begun_ += next;
      }
    }
  } else if (count == 0 || (errno != EINTR && errno != EAGAIN)) {
    ended_ = true;
    if (!begun_.empty()) {
      lines.push_back(std::exchange(begun_, {}));
    }
  }
  return lines;
}

}  // namespace sim
