#include "platform/linux/InstanceCall.h"

#include <sys/socket.h>

#include <array>
#include <cerrno>
#include <cstring>

#include "platform/linux/InstanceSocket.h"

std::optional<InstanceCall> InstanceCall::Accept(int listener, bool& failed) {
  Descriptor connection(accept4(listener, nullptr, nullptr, SOCK_CLOEXEC | SOCK_NONBLOCK));
  failed = connection.Number() < 0 && errno != EAGAIN && errno != EINTR && errno != ECONNABORTED;
  if (connection.Number() < 0 || !IsOfThisUser(connection.Number())) {
    return std::nullopt;
  }
  return InstanceCall(std::move(connection));
}

InstanceCall::State InstanceCall::Read() {
  std::array<char, 4096> buffer;
  while (received_.size() <= LongestInstanceLine) {
    const ssize_t got = recv(Number(), buffer.data(), buffer.size(), 0);
    if (got < 0 && errno == EINTR) {
      continue;
    }
    if (got < 0 && errno == EAGAIN) {
      return Check();
    }
    if (got <= 0) {
      return Check() == State::Complete ? State::Complete : State::Refused;
    }
    received_.append(buffer.data(), static_cast<std::size_t>(got));
  }
  return State::Refused;
}

InstanceCall::State InstanceCall::Check() {
  const std::size_t end = received_.find('\n');
  if (end == std::string::npos) {
    return State::Pending;
  }
  const std::optional<InstanceRequest> request =
      end + 1 == received_.size() ? ReadInstanceLine(std::string_view(received_).substr(0, end))
                                  : std::nullopt;
  if (!request) {
    return State::Refused;
  }
  request_ = *request;
  return State::Complete;
}

bool InstanceCall::Answer() const {
  const std::size_t length = std::strlen(InstanceAnswer);
  return send(Number(), InstanceAnswer, length, MSG_NOSIGNAL) == static_cast<ssize_t>(length);
}
