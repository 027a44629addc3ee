#pragma once

#include <gtest/gtest.h>

#include <chrono>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>
#include <thread>

#include "sim/baseunit/BaseUnitAnswer.h"
#include "tests/support/RawHost.h"
#include "tests/support/VenueProcess.h"

namespace sim {

/// The program tessarine-venue, with a folder of the test's own.
class VenueProgram : public testing::Test {
 protected:
  VenueProgram() {
    std::string pattern = (std::filesystem::temp_directory_path() / "tessarine-venue-XXXXXX").string();
    folder_ = ::mkdtemp(pattern.data());
  }
  ~VenueProgram() override { std::filesystem::remove_all(folder_); }

  std::string File(const std::string& name) const { return (folder_ / name).string(); }

  static std::string Content(const std::string& path) {
    std::ifstream file(path, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
  }

  // False when `text` does not come into the file within the limit.
  static bool AwaitContent(const std::string& path, const std::string& text) {
    const auto end = std::chrono::steady_clock::now() + Limit;
    while (Content(path).find(text) == std::string::npos) {
      if (std::chrono::steady_clock::now() > end) {
        return false;
      }
      std::this_thread::sleep_for(std::chrono::milliseconds(1));
    }
    return true;
  }

  // Every frame must be as `answer` has it.
  static void Download(const std::string& device, const BaseUnitAnswer& answer) {
    RawHost host(device);
    host.Write({1, 0});
    EXPECT_EQ(host.Read(1), Bytes{answer.Count});
    for (const Bytes& frame : answer.Frames) {
      EXPECT_EQ(host.Read(frame.size()), frame);
      host.Write({170});
    }
  }

  std::filesystem::path folder_;
};

}  // namespace sim
