#pragma once

#include <string>

#include "sim/line/FileDescriptor.h"

namespace sim {

/// Notices when a client opens a line. Opens before the watch began do not count.
class OpenWatch {
 public:
  /// Throws std::system_error.
  explicit OpenWatch(const std::string& path);

  /// True if the line has been opened since this was asked last.
  bool TakeOpening();

 private:
  FileDescriptor events_;
};

}  // namespace sim
