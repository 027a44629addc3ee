#include "sim/line/PseudoTerminal.h"

#include <fcntl.h>
#include <poll.h>
#include <stdlib.h>
#include <sys/eventfd.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <system_error>
#include <thread>
#include <utility>

#include "sim/line/PortLock.h"

namespace sim {
namespace {

constexpr std::chrono::milliseconds TearPause{3};

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

FileDescriptor OpenRaw(const std::string& slavePath, const LineSettings& settings) {
  FileDescriptor slave(::open(slavePath.c_str(), O_RDWR | O_NOCTTY | O_CLOEXEC));
  if (!slave.IsOpen()) {
    ThrowSystemError(slavePath.c_str());
  }
  SetRawLine(slave.Get(), settings);
  return slave;
}

}  // namespace

PseudoTerminal::PseudoTerminal(int baud, Pace pace)
    : PseudoTerminal(std::vector<LineSettings>{{.Baud = baud}}, pace) {}

PseudoTerminal::PseudoTerminal(std::vector<LineSettings> understood, Pace pace)
    : master_(::posix_openpt(O_RDWR | O_NOCTTY | O_CLOEXEC | O_NONBLOCK)),
      understood_(std::move(understood)),
      current_(understood_.front()),
      pace_(pace) {
  if (!master_.IsOpen()) {
    ThrowSystemError("pseudo terminal");
  }
  slavePath_ = SlavePathOf(master_.Get());
  AwaitPortUnlocked(slavePath_);
  slave_ = OpenRaw(slavePath_, current_);
  std::array<int, 2> wake{};
  if (::pipe2(wake.data(), O_CLOEXEC) != 0) {
    ThrowSystemError("pipe");
  }
  wakeReader_ = FileDescriptor(wake[0]);
  wakeWriter_ = FileDescriptor(wake[1]);
  nudges_ = FileDescriptor(::eventfd(0, EFD_CLOEXEC | EFD_NONBLOCK));
  if (!nudges_.IsOpen()) {
    ThrowSystemError("eventfd");
  }
}

void PseudoTerminal::SetUnderstood(std::vector<LineSettings> understood) {
  understood_ = std::move(understood);
  current_ = understood_.front();
}

std::optional<std::uint8_t> PseudoTerminal::ReadByte(std::optional<std::chrono::nanoseconds> timeout) {
  std::optional<Clock::time_point> deadline;
  if (timeout) {
    deadline = Clock::now() + *timeout;
  }
  while (IsUp() && !TakeNudge() && TakeArrivals()) {
    const Clock::time_point now = Clock::now();
    std::optional<Clock::time_point> wake = deadline;
    if (!arrivals_.empty()) {
      const Arrival next = arrivals_.front();
      if (next.Through <= now) {
        arrivals_.pop_front();
        return next.Byte;
      }
      wake = deadline ? std::min(*deadline, next.Through) : next.Through;
    }
    if (deadline && *deadline <= now) {
      break;
    }
    if (wake) {
      WaitFor(POLLIN, *wake - now);
    } else {
      WaitFor(POLLIN, std::nullopt);
    }
  }
  return std::nullopt;
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

std::size_t PseudoTerminal::Put(std::span<const std::uint8_t> bytes) {
  const ssize_t written = IsUp() ? ::write(master_.Get(), bytes.data(), bytes.size()) : 0;
  return written > 0 ? static_cast<std::size_t>(written) : 0;
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
    std::this_thread::sleep_for(TearPause);
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
  // The byte is never read, so later waits end too. A full pipe wakes just as well: the result is irrelevant.
  [[maybe_unused]] const ssize_t written = ::write(wakeWriter_.Get(), &wake, 1);
}

void PseudoTerminal::Nudge() {
  ::eventfd_write(nudges_.Get(), 1);
}

bool PseudoTerminal::TakeNudge() {
  eventfd_t count = 0;
  return ::eventfd_read(nudges_.Get(), &count) == 0;
}

std::chrono::nanoseconds PseudoTerminal::DurationOf(std::size_t bytes) const {
  if (!IsPaced()) {
    return std::chrono::nanoseconds(0);
  }
  constexpr std::int64_t nanosecondsOfTenBits = 10'000'000'000;
  // Rounded up once for the whole run of bytes: rounding each byte's share would let the error add up.
  return std::chrono::nanoseconds(
      (static_cast<std::int64_t>(bytes) * nanosecondsOfTenBits + current_.Baud - 1) / current_.Baud);
}

// Queues the bytes that have come, with the time at which each is through. False if the line has ended.
bool PseudoTerminal::TakeArrivals() {
  std::array<std::uint8_t, 256> bytes{};
  for (;;) {
    const ssize_t count = ::read(master_.Get(), bytes.data(), bytes.size());
    if (count <= 0) {
      return count < 0 && (errno == EAGAIN || errno == EINTR);
    }
    const std::span<const std::uint8_t> taken = std::span(bytes).first(static_cast<std::size_t>(count));
    if (!Understands(taken)) {
      continue;
    }
    for (const std::uint8_t byte : taken) {
      inputFree_ = std::max(inputFree_, Clock::now()) + DurationOf(1);
      arrivals_.push_back({byte, inputFree_});
    }
  }
}

// True if the settings at which `bytes` came are understood; they then become the current ones.
bool PseudoTerminal::Understands(std::span<const std::uint8_t> bytes) {
  const LineSettings host = ReadLineSettings(master_.Get());
  if (std::find(understood_.begin(), understood_.end(), host) != understood_.end()) {
    current_ = host;
    foreign_.reset();
    return true;
  }
  const bool begin = std::exchange(foreign_, host) != host;
  if (onForeignBytes_) {
    onForeignBytes_(host, bytes, begin);
  }
  return false;
}

// True if one of `events`, or the client closing, came before the timeout without an interruption.
bool PseudoTerminal::WaitFor(short events, std::optional<std::chrono::nanoseconds> timeout) {
  const Clock::time_point deadline = Clock::now() + timeout.value_or(std::chrono::nanoseconds(0));
  while (IsUp()) {
    timespec left{};
    if (timeout) {
      const std::int64_t nanoseconds =
          std::max<std::int64_t>(std::chrono::nanoseconds(deadline - Clock::now()).count(), 0);
      left.tv_sec = nanoseconds / std::nano::den;
      left.tv_nsec = nanoseconds % std::nano::den;
    }
    // Only a read can be nudged.
    const int nudges = (events & POLLIN) != 0 ? nudges_.Get() : -1;
    std::array<pollfd, 3> watched{pollfd{master_.Get(), events, 0}, pollfd{wakeReader_.Get(), POLLIN, 0},
                                  pollfd{nudges, POLLIN, 0}};
    const int ready = ::ppoll(watched.data(), watched.size(), timeout ? &left : nullptr, nullptr);
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
