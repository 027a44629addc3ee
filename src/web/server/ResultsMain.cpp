#include <unistd.h>

#include <charconv>
#include <csignal>
#include <cstdint>
#include <cstdio>
#include <optional>
#include <string_view>

#include "web/server/Confinement.h"
#include "web/server/ServerLoop.h"

namespace {

std::optional<std::uint16_t> PortIn(std::string_view word) {
  std::uint16_t port = 0;
  const auto [end, fault] = std::from_chars(word.data(), word.data() + word.size(), port);
  const bool whole = fault == std::errc() && end == word.data() + word.size();
  return whole && port > 0 ? std::optional(port) : std::nullopt;
}

ServerEnd Serve(const ServedAddress& wanted) {
  const ListenSocket socket = Listen(wanted);
  if (socket.Handle < 0) {
    return ServerEnd::NoAddress;
  }
  ServedPages pages;
  Visitors visitors;
  PageHost host(socket, pages, visitors);
  if (!host.Serving()) {
    return ServerEnd::NoAddress;
  }
  constexpr std::size_t ownHandles = 32;
  if (!Confine(PageHost::Limits().Connections + ownHandles)) {
    return ServerEnd::NotConfined;
  }
  ServerLoop loop(STDIN_FILENO, STDOUT_FILENO, host, pages, visitors);
  return loop.Run(socket.Served.Port);
}

}  // namespace

/// tessarine-results ADDRESS PORT: serves the pages that come at standard input.
int main(int argc, char** argv) {
  const auto port = argc == 3 ? PortIn(argv[2]) : std::nullopt;
  if (!port) {
    std::fputs("usage: tessarine-results ADDRESS PORT\nStarted by Tessarine; serves the pages it is given.\n",
               stderr);
    return static_cast<int>(ServerEnd::BadWords);
  }
  std::signal(SIGPIPE, SIG_IGN);
  return static_cast<int>(Serve({.Address = argv[1], .Port = *port}));
}
