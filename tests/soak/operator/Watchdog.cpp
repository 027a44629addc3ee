#include "tests/soak/operator/Watchdog.h"

#include <pthread.h>

#include <csignal>
#include <cstdio>
#include <cstdlib>

using std::chrono::steady_clock;

Watchdog::Watchdog(std::chrono::seconds patience)
    : patience_(patience), mainThread_(pthread_self()), thread_([this] { Watch(); }) {}

Watchdog::~Watchdog() {
  ended_ = true;
  thread_.join();
}

void Watchdog::NoteCommand(const std::string& command) {
  const std::lock_guard lock(mutex_);
  latestCommand_ = command;
}

void Watchdog::Watch() {
  long seen = beats_;
  steady_clock::time_point since = steady_clock::now();
  while (!ended_) {
    std::this_thread::sleep_for(std::chrono::milliseconds(50));
    if (beats_ != seen) {
      seen = beats_;
      since = steady_clock::now();
    } else if (steady_clock::now() - since > patience_) {
      const std::lock_guard lock(mutex_);
      std::printf("operator: hang for %ld s after: %s\n", static_cast<long>(patience_.count()),
                  latestCommand_.c_str());
      std::fflush(stdout);
      pthread_kill(mainThread_, SIGABRT);
      std::this_thread::sleep_for(std::chrono::seconds(20));
      std::_Exit(4);
    }
  }
}
