#pragma once

#include <cstdint>
#include <string>

#include "archive/ArchiveRoom.h"
#include "platform/linux/LinuxFiles.h"

/// A disk with that much space left.
class TightDisk : public LinuxFiles {
 public:
  std::uint64_t Space = LeastFreeSpace;
  std::uint64_t FreeSpace(const std::string& /*path*/) const override { return Space; }
};
