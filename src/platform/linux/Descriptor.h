#pragma once

#include <unistd.h>

#include <utility>

/// A file descriptor that is closed with this.
class Descriptor {
 public:
  Descriptor() = default;
  explicit Descriptor(int number) : number_(number) {}
  ~Descriptor() { Close(); }
  Descriptor(Descriptor&& other) noexcept : number_(std::exchange(other.number_, -1)) {}
  Descriptor& operator=(Descriptor&& other) noexcept {
    std::swap(number_, other.number_);
    return *this;
  }

  /// Negative for none.
  int Number() const { return number_; }

  void Close() {
    if (number_ >= 0) {
      close(number_);
      number_ = -1;
    }
  }

 private:
  int number_ = -1;
};
