#include <gtest/gtest.h>
#include <signal.h>
#include <sys/stat.h>
#include <sys/wait.h>

#include <chrono>
#include <thread>

#include "platform/jet/JetConverter.h"
#include "platform/linux/ChildProcess.h"
#include "tests/support/TemporaryFolder.h"

namespace {

/// The reader, waiting for ever to open its file.
class WaitingReader {
 public:
  WaitingReader() {
    const std::string pipe = folder_ / "members.mdb";
    mkfifo(pipe.c_str(), 0600);
    id_ = StartProcess({JetReaderPath(), pipe, "Members"}, {}, ProcessKind::Child);
  }
  ~WaitingReader() {
    kill(id_, SIGKILL);
    waitpid(id_, nullptr, 0);
  }
  WaitingReader(const WaitingReader&) = delete;
  WaitingReader& operator=(const WaitingReader&) = delete;

  /// Bytes of memory that it may ask for, as the system words it.
  std::string MostMemory() const {
    const std::string name = "Max address space";
    const std::string limits = ReadFile("/proc/" + std::to_string(id_) + "/limits");
    const std::size_t at = limits.find_first_not_of(' ', limits.find(name) + name.size());
    return limits.substr(at, limits.find(' ', at) - at);
  }

 private:
  TemporaryFolder folder_;
  pid_t id_ = 0;
};

#ifdef __has_feature
#if __has_feature(address_sanitizer)
#define WITH_ADDRESS_SANITIZER
#endif
#endif

#ifndef WITH_ADDRESS_SANITIZER  // which reserves terabytes of address space

TEST(JetReader, MayTakeTwoGigabytesOfMemory) {
  using namespace std::chrono_literals;
  const WaitingReader reader;
  const auto limit = std::chrono::steady_clock::now() + 20s;
  while (reader.MostMemory() != "2147483648" && std::chrono::steady_clock::now() < limit) {
    std::this_thread::sleep_for(5ms);
  }
  EXPECT_EQ(reader.MostMemory(), "2147483648");
}

#endif

}  // namespace
