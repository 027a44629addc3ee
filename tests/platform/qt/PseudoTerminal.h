#pragma once

#include <fcntl.h>
#include <poll.h>
#include <stdlib.h>
#include <termios.h>
#include <unistd.h>

#include <cstdint>
#include <stdexcept>
#include <string>
#include <vector>

#include "sim/line/PortLock.h"

/// A serial line whose far end the test controls.
class PseudoTerminal {
 public:
  PseudoTerminal() : master_(::posix_openpt(O_RDWR | O_NOCTTY | O_CLOEXEC)) {
    char name[64] = {};
    if (master_ < 0 || ::grantpt(master_) != 0 || ::unlockpt(master_) != 0 ||
        ::ptsname_r(master_, name, sizeof name) != 0) {
      throw std::runtime_error("No pseudo terminal to be had");
    }
    device_ = name;
    sim::AwaitPortUnlocked(device_);
    termios raw = Settings();
    ::cfmakeraw(&raw);
    ::tcsetattr(master_, TCSANOW, &raw);
  }
  ~PseudoTerminal() { Unplug(); }
  PseudoTerminal(const PseudoTerminal&) = delete;
  PseudoTerminal& operator=(const PseudoTerminal&) = delete;

  const std::string& Device() const { return device_; }

  /// The settings made at the near end.
  termios Settings() const {
    termios settings{};
    ::tcgetattr(master_, &settings);
    return settings;
  }

  void Write(const std::vector<std::uint8_t>& bytes) {
    if (::write(master_, bytes.data(), bytes.size()) != static_cast<ssize_t>(bytes.size())) {
      throw std::runtime_error("The pseudo terminal is full");
    }
  }

  /// The next `count` bytes from the near end; fewer if they do not arrive within 2 s.
  std::vector<std::uint8_t> Read(std::size_t count) {
    std::vector<std::uint8_t> bytes;
    pollfd readable{master_, POLLIN, 0};
    while (bytes.size() < count && ::poll(&readable, 1, 2000) == 1) {
      std::uint8_t byte = 0;
      if (::read(master_, &byte, 1) != 1) {
        break;
      }
      bytes.push_back(byte);
    }
    return bytes;
  }

  /// Closes the far end for good.
  void Unplug() {
    if (master_ >= 0) {
      ::close(master_);
    }
    master_ = -1;
  }

 private:
  int master_;
  std::string device_;
};
