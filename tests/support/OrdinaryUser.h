#pragma once

#include <unistd.h>
#include <stdexcept>

/// While it exists, file permissions apply even if the tests are run by root.
class OrdinaryUser {
 public:
  OrdinaryUser() {
    if (geteuid() == 0 && seteuid(Nobody) != 0) {
      throw std::runtime_error("cannot become an ordinary user");
    }
  }
  ~OrdinaryUser() {
    if (getuid() == 0 && seteuid(0) != 0) {
      std::terminate();
    }
  }
  OrdinaryUser(const OrdinaryUser&) = delete;
  OrdinaryUser& operator=(const OrdinaryUser&) = delete;

 private:
  static constexpr uid_t Nobody = 65534;
};
