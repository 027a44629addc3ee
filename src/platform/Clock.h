#pragma once

#include <string>

/// The present local time in the system locale's own forms, the year always in four digits.
class Clock {
 public:
  virtual ~Clock() = default;

  virtual std::string ShortDate() const = 0;
  virtual std::string ShortTime() const = 0;

  /// Local date and time as the databases keep them: "YYYY-MM-DD HH:MM:SS".
  virtual std::string Now() const = 0;

  /// The date in `text` (a short date, with or without a time behind it) in the locale's long form; `text`
  /// as it stands when there is none.
  virtual std::string LongDate(const std::string& text) const = 0;
};
