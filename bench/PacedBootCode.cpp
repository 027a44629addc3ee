#include "bench/PacedBootCode.h"

#include <fcntl.h>
#include <poll.h>
#include <stdlib.h>
#include <termios.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <stdexcept>

namespace {

using Clock = std::chrono::steady_clock;

constexpr std::chrono::nanoseconds TimeOfAByte = std::chrono::nanoseconds(std::chrono::seconds(10)) / 19200;

}  // namespace

PacedBootCode::PacedBootCode(std::size_t lineBytes)
    : lineBytes_(lineBytes), master_(::posix_openpt(O_RDWR | O_NOCTTY | O_CLOEXEC)) {
  if (master_ < 0 || ::grantpt(master_) != 0 || ::unlockpt(master_) != 0) {
    throw std::runtime_error("no pseudo terminal");
  }
  path_ = ::ptsname(master_);
  termios raw{};
  ::tcgetattr(master_, &raw);
  ::cfmakeraw(&raw);
  ::tcsetattr(master_, TCSANOW, &raw);
  thread_ = std::thread([this] { Run(stop_); });
}

PacedBootCode::~PacedBootCode() {
  stop_ = true;
  thread_.join();
  ::close(master_);
}

void PacedBootCode::Announce() {
  Send("BOOT");
}

double PacedBootCode::ToldSeconds() const {
  const auto time = TimeOfAByte * static_cast<std::int64_t>(bytes_.load()) +
                    std::chrono::nanoseconds(AnswerTime) * static_cast<std::int64_t>(answers_.load());
  return std::chrono::duration<double>(time).count();
}

void PacedBootCode::Send(const std::string& text) {
  bytes_ += text.size();
  if (::write(master_, text.data(), text.size()) != static_cast<ssize_t>(text.size())) {
    throw std::runtime_error("the pseudo terminal is full");
  }
}

std::size_t PacedBootCode::SizeOf(char command) const {
  switch (command) {
    case 'S':
      return 4;
    case 'E':
      return 6;
    case 'Z':
      return lineBytes_ > 0 ? 1 + lineBytes_ : 198;
    default:
      return 1;
  }
}

char PacedBootCode::AnswerTo(char command) const {
  switch (command) {
    case 'X':
      return 'x';
    case 'P':
      return lineBytes_ > 0 ? 'p' : 'd';
    case 'B':
      return lineBytes_ > 0 ? 'b' : 's';
    case 'E':
      return 'b';
    default:
      return 'f';
  }
}

void PacedBootCode::Run(const std::atomic<bool>& stop) {
  Clock::time_point wireIdle = Clock::now();
  char command = 0;
  std::size_t left = 0;
  while (!stop) {
    pollfd line{master_, POLLIN, 0};
    std::array<char, 256> bytes{};
    if (::poll(&line, 1, 20) <= 0 || (line.revents & POLLIN) == 0) {
      if ((line.revents & POLLHUP) != 0) {
        std::this_thread::sleep_for(std::chrono::milliseconds(1));  // closed: it would hang up at each look
      }
      continue;
    }
    const ssize_t count = ::read(master_, bytes.data(), bytes.size());
    for (ssize_t i = 0; i < count; ++i) {
      wireIdle = std::max(wireIdle, Clock::now()) + TimeOfAByte;
      ++bytes_;
      if (left == 0) {
        command = bytes[static_cast<std::size_t>(i)];
        left = SizeOf(command);
      }
      if (--left == 0) {
        // The answer is there when its own byte has passed the wire.
        wireIdle += AnswerTime + TimeOfAByte;
        std::this_thread::sleep_until(wireIdle);
        ++answers_;
        Send(std::string(1, AnswerTo(command)));
      }
    }
  }
}
