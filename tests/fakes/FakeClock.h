#pragma once

#include <string>

#include "platform/Clock.h"

/// A clock that stands still.
class FakeClock : public Clock {
 public:
  std::string Date = "21/05/2013";
  std::string Time = "14:30";

  std::string ShortDate() const override { return Date; }
  std::string ShortTime() const override { return Time; }
};
