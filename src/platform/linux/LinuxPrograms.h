#pragma once

#include <sys/types.h>

#include <string>
#include <vector>

#include "platform/Programs.h"

/// Programs started in sessions of their own, without a terminal.
class LinuxPrograms : public Programs {
 public:
  LinuxPrograms() = default;
  /// Leaves the programs running.
  ~LinuxPrograms() override = default;
  LinuxPrograms(const LinuxPrograms&) = delete;
  LinuxPrograms& operator=(const LinuxPrograms&) = delete;

  void Start(const std::vector<std::string>& words) override;

 private:
  /// Takes note of those that have ended, whose entries in the system's table would stay else.
  void ForgetEnded();

  std::vector<pid_t> running_;
};
