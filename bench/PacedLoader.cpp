#include "bench/PacedLoader.h"

#include <fcntl.h>
#include <poll.h>
#include <pty.h>
#include <termios.h>
#include <unistd.h>

#include <algorithm>
#include <stdexcept>

namespace {

using LineClock = std::chrono::steady_clock;

constexpr std::uint8_t Stx = 0x55;
constexpr std::uint8_t Etx = 0x04;
constexpr std::uint8_t Dle = 0x05;
constexpr std::size_t HeaderBytes = 5;

}  // namespace

PacedLoader::PacedLoader(int baud)
    : timeOfByte_(std::chrono::nanoseconds(std::chrono::seconds(10)) / baud), terminal_(-1), other_(-1) {
  char name[64];
  termios raw{};
  cfmakeraw(&raw);
  if (openpty(&terminal_, &other_, name, &raw, nullptr) != 0) {
    throw std::runtime_error("no pseudo terminal");
  }
  device_ = name;
  thread_ = std::thread([this] { Serve(); });
}

PacedLoader::~PacedLoader() {
  ended_ = true;
  thread_.join();
  close(terminal_);
  close(other_);
}

void PacedLoader::Serve() {
  idleAt_ = LineClock::now();
  while (!ended_) {
    pollfd line{terminal_, POLLIN, 0};
    if (poll(&line, 1, 50) <= 0) {
      continue;
    }
    std::uint8_t buffer[256];
    const ssize_t count = read(terminal_, buffer, sizeof buffer);
    for (ssize_t i = 0; i < count; ++i) {
      idleAt_ = std::max(idleAt_, LineClock::now()) + timeOfByte_;
      ++bytes_;
      Take(buffer[i]);
    }
  }
}

void PacedLoader::Take(std::uint8_t byte) {
  if (escaped_) {
    escaped_ = false;
    packet_.push_back(byte);
  } else if (byte == Dle) {
    escaped_ = true;
  } else if (byte == Stx) {
    packet_.clear();
  } else if (byte == Etx) {
    std::this_thread::sleep_until(idleAt_);
    Obey();
    packet_.clear();
  } else {
    packet_.push_back(byte);
  }
}

void PacedLoader::Obey() {
  if (packet_.size() <= HeaderBytes) {
    return;
  }
  const std::uint32_t address = packet_[2] + packet_[3] * 256U + packet_[4] * 65536U;
  if (packet_[0] == 2) {
    rows_[address] = std::vector<std::uint8_t>(packet_.begin() + HeaderBytes, packet_.end() - 1);
    Send({2});
  } else if (packet_[0] == 1) {
    std::vector<std::uint8_t> answer(packet_.begin(), packet_.begin() + HeaderBytes);
    answer.insert(answer.end(), rows_[address].begin(), rows_[address].end());
    Send(std::move(answer));
  }
}

void PacedLoader::Send(std::vector<std::uint8_t> data) {
  std::uint8_t sum = 0;
  for (const std::uint8_t byte : data) {
    sum = static_cast<std::uint8_t>(sum + byte);
  }
  data.push_back(static_cast<std::uint8_t>(-sum));
  std::vector<std::uint8_t> line = {Stx, Stx};
  for (const std::uint8_t byte : data) {
    if (byte == Stx || byte == Etx || byte == Dle) {
      line.push_back(Dle);
    }
    line.push_back(byte);
  }
  line.push_back(Etx);
  // In pieces of 16, so that this is no test of the system's timers. The line is busy from the first to the
  // last byte, however late this thread wakes up between them.
  constexpr std::size_t piece = 16;
  idleAt_ = std::max(idleAt_, LineClock::now());
  for (std::size_t at = 0; at < line.size(); at += piece) {
    const std::size_t count = std::min(piece, line.size() - at);
    idleAt_ += count * timeOfByte_;
    std::this_thread::sleep_until(idleAt_);
    if (write(terminal_, line.data() + at, count) != static_cast<ssize_t>(count)) {
      return;
    }
    bytes_ += count;
  }
}
