#pragma once

#include <gtest/gtest.h>
#include <sys/file.h>
#include <sys/ioctl.h>

#include <chrono>
#include <cstdint>
#include <string>
#include <thread>
#include <vector>

#include "platform/qt/QtEventPump.h"
#include "platform/qt/QtSerialPort.h"
#include "tests/platform/qt/PseudoTerminal.h"
#include "tests/support/Bytes.h"
#include "tests/support/FailureOf.h"

/// A second descriptor for a terminal's near end.
class SecondOpener {
 public:
  explicit SecondOpener(const std::string& device)
      : descriptor_(::open(device.c_str(), O_RDWR | O_NOCTTY | O_NONBLOCK | O_CLOEXEC)) {}
  ~SecondOpener() { ::close(descriptor_); }
  SecondOpener(const SecondOpener&) = delete;
  SecondOpener& operator=(const SecondOpener&) = delete;

  bool SetExclusive(bool on) const { return ::ioctl(descriptor_, on ? TIOCEXCL : TIOCNXCL) == 0; }
  bool IsExclusive() const {
    int exclusive = 0;
    return ::ioctl(descriptor_, TIOCGEXCL, &exclusive) == 0 && exclusive != 0;
  }
  bool Lock() const { return ::flock(descriptor_, LOCK_EX | LOCK_NB) == 0; }
  /// True once the line has accepted no more bytes for 100 ms.
  bool AwaitFull() const {
    pollfd writable{descriptor_, POLLOUT, 0};
    const auto limit = std::chrono::steady_clock::now() + std::chrono::seconds(2);
    while (::poll(&writable, 1, 100) != 0) {
      if (std::chrono::steady_clock::now() > limit) {
        return false;
      }
      std::this_thread::yield();
    }
    return true;
  }

  bool AwaitInput() const {
    pollfd readable{descriptor_, POLLIN, 0};
    return ::poll(&readable, 1, 2000) == 1;
  }

 private:
  int descriptor_;
};

class QtSerialPortTest : public testing::Test {
 protected:
  void Open(const std::string& settings = "19200,N,8,1") { Port.Open(Line.Device(), settings); }

  int OpenFailure(const std::string& device, const std::string& settings = "19200,N,8,1") {
    return FailureOf([&] { Port.Open(device, settings); });
  }

  void PutOut(int count) {
    for (int i = 0; i < count; ++i) {
      Port.Output(85);
    }
  }

  bool Await(std::size_t count) {
    return Pump.WaitFor([&] { return Port.InBufferCount() >= count; }, std::chrono::seconds(5)) ==
           WaitResult::Met;
  }

  Bytes Take(std::size_t count) {
    Bytes bytes;
    for (; count > 0 && Await(1); --count) {
      bytes.push_back(Port.Input());
    }
    return bytes;
  }

  QtEventPump Pump;
  PseudoTerminal Line;
  QtSerialPort Port;
};
