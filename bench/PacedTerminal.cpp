#include "bench/PacedTerminal.h"

#include <fcntl.h>
#include <poll.h>
#include <stdlib.h>
#include <termios.h>
#include <unistd.h>

#include <algorithm>
#include <cstdio>
#include <utility>

PacedTerminal::PacedTerminal(int baud, std::chrono::microseconds delay, Device device)
    : byteTime_(std::chrono::nanoseconds(std::chrono::seconds(10)) / baud),
      delay_(delay),
      device_(std::move(device)),
      descriptor_(::posix_openpt(O_RDWR | O_NOCTTY)) {
  char name[64] = {};
  if (descriptor_ < 0 || ::grantpt(descriptor_) != 0 || ::unlockpt(descriptor_) != 0 ||
      ::ptsname_r(descriptor_, name, sizeof name) != 0) {
    std::perror("pseudo terminal");
    std::exit(1);
  }
  path_ = name;
  hostSide_ = ::open(name, O_RDWR | O_NOCTTY);
  termios raw{};
  ::tcgetattr(hostSide_, &raw);
  ::cfmakeraw(&raw);
  ::tcsetattr(hostSide_, TCSANOW, &raw);
  thread_ = std::jthread([this](const std::stop_token& stop) { Run(stop); });
}

PacedTerminal::~PacedTerminal() {
  thread_.request_stop();
  thread_.join();
  ::close(hostSide_);
  ::close(descriptor_);
}

std::vector<PacedTerminal::Clock::time_point> PacedTerminal::Arrivals() const {
  const std::lock_guard lock(mutex_);
  return arrivals_;
}

void PacedTerminal::Run(const std::stop_token& stop) {
  constexpr int lookMilliseconds = 50;
  idle_ = Clock::now();
  while (!stop.stop_requested()) {
    pollfd line{descriptor_, POLLIN, 0};
    // A byte that is there already follows the one before without a gap, however late this thread woke up.
    const bool follows = ::poll(&line, 1, 0) > 0 && Clock::now() < idle_ + byteTime_;
    std::uint8_t byte = 0;
    if ((!follows && ::poll(&line, 1, lookMilliseconds) <= 0) || ::read(descriptor_, &byte, 1) != 1) {
      continue;
    }
    idle_ = (follows ? idle_ : std::max(idle_, Clock::now())) + byteTime_;
    std::this_thread::sleep_until(idle_);
    {
      const std::lock_guard lock(mutex_);
      arrivals_.push_back(idle_);
    }
    Answer(device_(byte), idle_ + delay_);
  }
}

void PacedTerminal::Answer(const std::vector<std::uint8_t>& bytes, Clock::time_point from) {
  for (const std::uint8_t byte : bytes) {
    answered_ = std::max(answered_, from) + byteTime_;
    // The next byte from the host comes in meanwhile, so only an answer without one is waited for.
    pollfd line{descriptor_, POLLIN, 0};
    if (::poll(&line, 1, 0) == 0) {
      std::this_thread::sleep_until(answered_);
      idle_ = std::max(idle_, answered_);  // nothing came until then
    }
    if (::write(descriptor_, &byte, 1) != 1) {
      std::perror("answer");
    }
  }
}
