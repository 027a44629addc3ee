#pragma once

#include <string>

/// The present local time in the system locale's own forms, the year always in four digits.
class Clock {
 public:
  virtual ~Clock() = default;

  virtual std::string ShortDate() const = 0;
  virtual std::string ShortTime() const = 0;
};
