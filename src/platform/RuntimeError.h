#pragma once

#include <stdexcept>
#include <string>

#include "platform/Fault.h"

/// A failure that an operation of the platform, or a conversion, reports by number (Fault) and text.
class RuntimeError : public std::runtime_error {
 public:
  /// With the usual text of `number`.
  explicit RuntimeError(int number) : RuntimeError(number, std::string(Fault::TextOf(number))) {}
  RuntimeError(int number, const std::string& text) : std::runtime_error(text), number_(number) {}

  int Number() const { return number_; }

 private:
  int number_;
};
