#pragma once

#include <stdexcept>
#include <string>

#include "platform/Fault.h"

/// A failure of a platform operation or a conversion, with its number (see Fault) and text.
class RuntimeError : public std::runtime_error {
 public:
  /// With the standard text for `number`.
  explicit RuntimeError(int number) : RuntimeError(number, std::string(Fault::TextOf(number))) {}
  RuntimeError(int number, const std::string& text) : std::runtime_error(text), number_(number) {}

  int Number() const { return number_; }

 private:
  int number_;
};
