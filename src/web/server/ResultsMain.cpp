#include <unistd.h>

#include <algorithm>
#include <charconv>
#include <csignal>
#include <cstdint>
#include <cstdio>
#include <optional>
#include <string>
#include <string_view>

#include "web/server/Confinement.h"
#include "web/server/ServerLoop.h"
#include "web/server/TrialRequest.h"

namespace {

std::optional<std::uint16_t> PortIn(std::string_view word) {
  std::uint16_t port = 0;
  const auto [end, fault] = std::from_chars(word.data(), word.data() + word.size(), port);
  const bool whole = fault == std::errc() && end == word.data() + word.size();
  return whole && port > 0 ? std::optional(port) : std::nullopt;
}

/// Fewer are not enough for the phones of a game.
constexpr std::size_t LeastHandles = 128;

ServerEnd Serve(const ServedAddress& wanted) {
  const ListenSocket socket = Listen(wanted);
  if (socket.Handle < 0) {
    return ServerEnd::NoAddress;
  }
  ServedPages pages;
  Visitors visitors;
  constexpr std::size_t ownHandles = 32;
  PageHost::Limits limits;
  const std::size_t handles = std::min(limits.Connections + ownHandles, MostHandles());
  if (handles < LeastHandles) {
    return ServerEnd::NotConfined;
  }
  limits.Connections = static_cast<unsigned>(handles - ownHandles);
  PageHost host(socket, pages, visitors, limits);
  if (!host.Serving()) {
    return ServerEnd::NoAddress;
  }
  if (!Confine(handles)) {
    return ServerEnd::NotConfined;
  }
  ServerLoop loop(STDIN_FILENO, STDOUT_FILENO, host, pages, visitors);
  return loop.Run(socket.Served.Port);
}

/// Reports whether the pages are answered with there.
int Ask(const ServedAddress& served) {
  constexpr unsigned longestSeconds = 10;  // whatever happens, nobody finds it hanging
  alarm(longestSeconds);
  const std::string bytes =
      EncodeReport({.Kind = ReportKind::Answer, .Number = IsAnswered(served) ? 1U : 0U});
  return write(STDOUT_FILENO, bytes.data(), bytes.size()) == static_cast<ssize_t>(bytes.size()) ? 0 : 1;
}

}  // namespace

/// tessarine-results ADDRESS PORT: serves the pages that come at standard input.
/// tessarine-results --ask ADDRESS PORT: reports whether pages are served there.
int main(int argc, char** argv) {
  if (argc == 4 && std::string_view(argv[1]) == "--ask") {
    const auto asked = PortIn(argv[3]);
    return asked ? Ask({.Address = argv[2], .Port = *asked}) : static_cast<int>(ServerEnd::BadWords);
  }
  const auto port = argc == 3 ? PortIn(argv[2]) : std::nullopt;
  if (!port) {
    std::fputs("usage: tessarine-results ADDRESS PORT\nStarted by Tessarine; serves the pages it is given.\n",
               stderr);
    return static_cast<int>(ServerEnd::BadWords);
  }
  std::signal(SIGPIPE, SIG_IGN);
  return static_cast<int>(Serve({.Address = argv[1], .Port = *port}));
}
