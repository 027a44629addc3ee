#pragma once

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <string>

/// What kept connections got out of a server.
struct PageLoad {
  double RequestsPerSecond = 0;
  std::size_t Failures = 0;  ///< connections that ended, and answers other than 200
};

/// Asks this computer's server at `port` for `path` over that many connections for that long, each asking
/// again as soon as it has its answer.
PageLoad LoadServer(std::uint16_t port, const std::string& path, int connections,
                    std::chrono::milliseconds time);
