#include "tests/support/RawHost.h"

#include <fcntl.h>
#include <gtest/gtest.h>
#include <poll.h>
#include <unistd.h>

namespace sim {

RawHost::RawHost(const std::string& path) : line_(::open(path.c_str(), O_RDWR | O_NOCTTY | O_CLOEXEC)) {
  EXPECT_TRUE(line_.IsOpen()) << path;
}

void RawHost::Write(const Bytes& bytes) {
  EXPECT_EQ(::write(line_.Get(), bytes.data(), bytes.size()), static_cast<ssize_t>(bytes.size()));
}

std::optional<std::uint8_t> RawHost::ReadByte(std::chrono::milliseconds longestWait) {
  pollfd watched{line_.Get(), POLLIN, 0};
  if (::poll(&watched, 1, static_cast<int>(longestWait.count())) <= 0) {
    return std::nullopt;
  }
  std::uint8_t byte = 0;
  if (::read(line_.Get(), &byte, 1) != 1) {
    hungUp_ = true;
    return std::nullopt;
  }
  return byte;
}

Bytes RawHost::Read(std::size_t count) {
  Bytes bytes;
  while (bytes.size() < count) {
    const std::optional<std::uint8_t> byte = ReadByte();
    if (!byte) {
      break;
    }
    bytes.push_back(*byte);
  }
  return bytes;
}

Bytes RawHost::ReadUntilHangUp() {
  Bytes bytes;
  while (const std::optional<std::uint8_t> byte = ReadByte()) {
    bytes.push_back(*byte);
  }
  return bytes;
}

}  // namespace sim
