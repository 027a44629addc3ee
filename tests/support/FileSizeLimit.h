#pragma once

#include <sys/resource.h>
#include <csignal>
#include <stdexcept>

/// While it exists, no file of this process can grow beyond `bytes`; a write that would do so fails instead.
class FileSizeLimit {
 public:
  explicit FileSizeLimit(rlim_t bytes) : oldHandler_(std::signal(SIGXFSZ, SIG_IGN)) {
    getrlimit(RLIMIT_FSIZE, &old_);
    const rlimit limit{bytes, old_.rlim_max};
    if (setrlimit(RLIMIT_FSIZE, &limit) != 0) {
      throw std::runtime_error("cannot limit the size of files");
    }
  }
  ~FileSizeLimit() {
    setrlimit(RLIMIT_FSIZE, &old_);
    std::signal(SIGXFSZ, oldHandler_);
  }
  FileSizeLimit(const FileSizeLimit&) = delete;
  FileSizeLimit& operator=(const FileSizeLimit&) = delete;

 private:
  rlimit old_{};
  void (*oldHandler_)(int);
};
