#include "web/server/ListenSocket.h"

#include <netinet/in.h>
#include <sys/socket.h>
#include <unistd.h>

#include <cerrno>

namespace {

constexpr int WaitingConnections = 256;

/// Bytes that the system holds for each connection whose other end does not read them. By itself it would
/// take megabytes, and filling those of hundreds of connections would keep the others waiting.
constexpr int Unsent = 128 * 1024;

/// A listening socket; -1 with errno if there is none.
int ListenAt(const SocketAddress& address) {
  const auto* plain = reinterpret_cast<const sockaddr*>(&address.Storage);
  const int handle = socket(plain->sa_family, SOCK_STREAM | SOCK_NONBLOCK | SOCK_CLOEXEC, 0);
  if (handle < 0) {
    return -1;
  }
  const int on = 1;
  setsockopt(handle, SOL_SOCKET, SO_REUSEADDR, &on, sizeof on);
  setsockopt(handle, SOL_SOCKET, SO_SNDBUF, &Unsent, sizeof Unsent);  // accepted ones have it from here
  if (plain->sa_family == AF_INET6) {
    setsockopt(handle, IPPROTO_IPV6, IPV6_V6ONLY, &on, sizeof on);
  }
  if (bind(handle, plain, address.Length) != 0 || listen(handle, WaitingConnections) != 0) {
    const int fault = errno;
    close(handle);
    errno = fault;
    return -1;
  }
  return handle;
}

}  // namespace

ListenSocket Listen(const ServedAddress& wanted) {
  ListenSocket result{.Handle = -1, .Served = wanted};
  for (int tried = 0; tried < TriedPorts && wanted.Port + tried <= 65535; ++tried) {
    result.Served.Port = static_cast<std::uint16_t>(wanted.Port + tried);
    const auto address = SocketAddressOf(result.Served);
    if (!address || !IsPrivate(reinterpret_cast<const sockaddr&>(address->Storage))) {
      return result;
    }
    result.Handle = ListenAt(*address);
    if (result.Handle >= 0 || (errno != EADDRINUSE && errno != EACCES)) {
      return result;
    }
  }
  return result;
}
