#pragma once

#include <cstdint>
#include <optional>
#include <string>

#include "platform/linux/ChildProcess.h"

/// Another web server, nginx as one process, that serves the same bytes from a file.
class PageServerPeer {
 public:
  static constexpr std::uint16_t Port = 18'650;

  /// `program` is nginx; `folder` an empty one for its files; `body` what it answers with at "/".
  PageServerPeer(const std::string& program, const std::string& folder, const std::string& body);

  /// Waits until it answers; false if it does not within some seconds.
  bool Answers();

 private:
  std::optional<ChildProcess> process_;
};

/// The nginx named by TESSARINE_NGINX, else the one on the search path or in the folder of system programs;
/// empty without one.
std::string FindPageServerPeer();
