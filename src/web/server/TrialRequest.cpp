#include "web/server/TrialRequest.h"

#include <sys/socket.h>
#include <sys/time.h>
#include <unistd.h>

#include <array>
#include <string>

namespace {

constexpr timeval LongestWait{.tv_sec = 3, .tv_usec = 0};

/// A connection to the address; -1 if there is none.
int Connect(const SocketAddress& address) {
  const auto* plain = reinterpret_cast<const sockaddr*>(&address.Storage);
  const int handle = socket(plain->sa_family, SOCK_STREAM | SOCK_CLOEXEC, 0);
  if (handle < 0) {
    return -1;
  }
  setsockopt(handle, SOL_SOCKET, SO_RCVTIMEO, &LongestWait, sizeof LongestWait);
  setsockopt(handle, SOL_SOCKET, SO_SNDTIMEO, &LongestWait, sizeof LongestWait);
  if (connect(handle, plain, address.Length) != 0) {
    close(handle);
    return -1;
  }
  return handle;
}

/// The first bytes of what comes, as many as `count` at most.
std::string Receive(int handle, std::size_t count) {
  std::string text;
  std::array<char, 64> bytes{};
  while (text.size() < count) {
    const ssize_t got = recv(handle, bytes.data(), std::min(bytes.size(), count - text.size()), 0);
    if (got <= 0) {
      break;
    }
    text.append(bytes.data(), static_cast<std::size_t>(got));
  }
  return text;
}

}  // namespace

bool IsAnswered(const ServedAddress& served) {
  const auto address = SocketAddressOf(served);
  if (!address || !IsPrivate(reinterpret_cast<const sockaddr&>(address->Storage))) {
    return false;
  }
  const int handle = Connect(*address);
  if (handle < 0) {
    return false;
  }
  std::string request = "HEAD /now HTTP/1.1\r\nHost: ";
  request.append(HostsOf(served).front()).append("\r\nConnection: close\r\n\r\n");
  const bool isSent =
      send(handle, request.data(), request.size(), MSG_NOSIGNAL) == static_cast<ssize_t>(request.size());
  constexpr std::string_view good = "HTTP/1.1 200 ";
  const bool isGood = isSent && Receive(handle, good.size()) == good;
  close(handle);
  return isGood;
}
