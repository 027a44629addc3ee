#pragma once

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>

/// A kept connection of a browser to this computer's server.
class PageConnection {
 public:
  /// Throws std::runtime_error when the server refuses it, as do all others when the connection has ended.
  explicit PageConnection(std::uint16_t port);
  ~PageConnection();
  PageConnection(const PageConnection&) = delete;
  PageConnection& operator=(const PageConnection&) = delete;

  int Handle() const { return handle_; }

  /// Further paths may be asked for before the first is answered.
  void Ask(const std::string& path) const;

  /// Takes what has come.
  void Receive();

  /// The next answer's body, once it is there whole. Throws std::runtime_error for an answer other than 200.
  std::optional<std::string> NextBody();

 private:
  int handle_;
  std::uint16_t port_;
  std::string answers_;
};

/// What kept connections got out of a server.
struct PageLoad {
  double RequestsPerSecond = 0;
  std::size_t Failures = 0;  ///< connections that ended, and answers other than 200
};

/// Asks this computer's server at `port` for `path` over that many connections for that long, each asking
/// again as soon as it has its answer.
PageLoad LoadServer(std::uint16_t port, const std::string& path, int connections,
                    std::chrono::milliseconds time);
