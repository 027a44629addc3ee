#include "sim/PseudoTerminal.h"

#include <fcntl.h>
#include <poll.h>
#include <stdlib.h>
#include <termios.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <system_error>
#include <thread>

namespace sim {
namespace {

constexpr std::chrono::milliseconds tearPause{3};

[[noreturn]] void ThrowSystemError(const char* what) {
  throw std::system_error(errno, std::generic_category(), what);
}

std::string SlavePathOf(int master) {
  std::array<char, 128> path{};
  if (::grantpt(master) != 0 || ::unlockpt(master) != 0 ||
      ::ptsname_r(master, path.data(), path.size()) != 0) {
    ThrowSystemError("pseudo terminal");
  }
  return path.data();
}

FileDescriptor OpenRaw(const std::string& slavePath) {
  FileDescriptor slave(::open(slavePath.c_str(), O_RDWR | O_NOCTTY | O_CLOEXEC));
  termios settings{};
  if (!slave.IsOpen() || ::tcgetattr(slave.Get(), &settings) != 0) {
    ThrowSystemError(slavePath.c_str());
  }
  ::cfmakeraw(&settings);
  if (::tcsetattr(slave.Get(), TCSANOW, &settings) != 0) {
    ThrowSystemError(slavePath.c_str());
  }
  return slave;
}

}  // namespace

PseudoTerminal::PseudoTerminal(int baud, Pace pace)
    : master_(::posix_openpt(O_RDWR | O_NOCTTY | O_CLOEXEC | O_NONBLOCK)), baud_(baud), pace_(pace) {
  if (!master_.IsOpen()) {
    ThrowSystemError("pseudo terminal");
  }
  slavePath_ = SlavePathOf(master_.Get());
  slave_ = OpenRaw(slavePath_);
  std::array<int, 2> wake{};
  if (::pipe2(wake.data(), O_CLOEXEC) != 0) {
    ThrowSystemError("pipe");
  }
  wakeReader_ = FileDescriptor(wake[0]);
  wakeWriter_ = FileDescriptor(wake[1]);
}

std::optional<std::uint8_t> PseudoTerminal::ReadByte(std::optional<std::chrono::milliseconds> timeout) {
  std::uint8_t byte = 0;
  if (!WaitFor(POLLIN, timeout) || ::read(master_.Get(), &byte, 1) != 1) {
    return std::nullopt;
  }
  if (IsPaced()) {
    inputFree_ = std::max(inputFree_, Clock::now()) + DurationOf(1);
    std::this_thread::sleep_until(inputFree_);
  }
  return byte;
}

std::size_t PseudoTerminal::Write(std::span<const std::uint8_t> bytes) {
  if (!IsPaced()) {
    return WriteAtOnce(bytes);
  }
  const Clock::time_point start = Clock::now();
  for (std::size_t i = 0; i < bytes.size(); ++i) {
    std::this_thread::sleep_until(start + DurationOf(i + 1));
    if (interrupted_ || WriteAtOnce(bytes.subspan(i, 1)) != 1) {
      return i;
    }
  }
  return bytes.size();
}

std::size_t PseudoTerminal::WriteTorn(std::span<const std::uint8_t> bytes) {
  std::size_t sent = 0;
  for (std::size_t length = 1; sent < bytes.size(); length = length % 3 + 1) {
    const std::span<const std::uint8_t> piece = bytes.subspan(sent, std::min(length, bytes.size() - sent));
    const std::size_t sentNow = Write(piece);
    sent += sentNow;
    if (sentNow < piece.size()) {
      break;
    }
    std::this_thread::sleep_for(tearPause);
  }
  return sent;
}

void PseudoTerminal::HangUp() {
  slave_.Close();
  master_.Close();
}

bool PseudoTerminal::WaitForClientToClose(std::chrono::milliseconds limit) {
  slave_.Close();
  return WaitFor(0, limit);
}

void PseudoTerminal::Interrupt() {
  interrupted_ = true;
  const char wake = 0;
  // The byte stays in the pipe for good. A full pipe wakes just as well, so the result does not matter.
  [[maybe_unused]] const ssize_t written = ::write(wakeWriter_.Get(), &wake, 1);
}

std::chrono::nanoseconds PseudoTerminal::DurationOf(std::size_t bytes) const {
  constexpr std::int64_t nanosecondsOfTenBits = 10'000'000'000;
  // Rounded up once for the whole run of bytes: rounding each byte's share would let the error add up.
  return std::chrono::nanoseconds((static_cast<std::int64_t>(bytes) * nanosecondsOfTenBits + baud_ - 1) /
                                  baud_);
}

// True when one of `events`, or the client's closing, came before the time-out and no interruption did.
bool PseudoTerminal::WaitFor(short events, std::optional<std::chrono::milliseconds> timeout) {
  const Clock::time_point deadline = Clock::now() + timeout.value_or(std::chrono::milliseconds(0));
  while (!interrupted_ && master_.IsOpen()) {
    int wait = -1;
    if (timeout) {
      const auto left = std::chrono::ceil<std::chrono::milliseconds>(deadline - Clock::now());
      wait = static_cast<int>(std::max<std::int64_t>(left.count(), 0));
    }
    std::array<pollfd, 2> watched{pollfd{master_.Get(), events, 0}, pollfd{wakeReader_.Get(), POLLIN, 0}};
    const int ready = ::poll(watched.data(), watched.size(), wait);
    if (ready > 0) {
      return watched[1].revents == 0;
    }
    if (ready == 0 || errno != EINTR) {
      return false;
    }
  }
  return false;
}

std::size_t PseudoTerminal::WriteAtOnce(std::span<const std::uint8_t> bytes) {
  std::size_t sent = 0;
  while (sent < bytes.size() && master_.IsOpen()) {
    const ssize_t written = ::write(master_.Get(), bytes.data() + sent, bytes.size() - sent);
    if (written >= 0) {
      sent += static_cast<std::size_t>(written);
    } else if (errno == EAGAIN ? !WaitFor(POLLOUT, std::nullopt) : errno != EINTR) {
      break;
    }
  }
  return sent;
}

}  // namespace sim
