#pragma once

#include <map>
#include <string>

#include "platform/Clock.h"

/// A clock that stands still.
class FakeClock : public Clock {
 public:
  std::string Date = "21/05/2013";
  std::string Time = "14:30";
  std::string DateAndTime = "2013-05-21 14:30:05";

  std::string ShortDate() const override { return Date; }
  std::string ShortTime() const override { return Time; }
  std::string Now() const override { return DateAndTime; }

  /// Long dates by the text they are requested for; any other text is no date.
  std::map<std::string, std::string> LongDates = {{"21/05/2013 14:30", "Tuesday, 21 May 2013"}};

  std::string LongDate(const std::string& text) const override {
    const auto found = LongDates.find(text);
    return found == LongDates.end() ? text : found->second;
  }

  /// Stamps by the text they are requested for; any other text is no date.
  std::map<std::string, std::string> Stamps = {{"21/05/2013 14:30", "2013-05-21 14:30:00"}};

  std::string Stamp(const std::string& text) const override {
    const auto found = Stamps.find(text);
    return found == Stamps.end() ? std::string() : found->second;
  }
};
