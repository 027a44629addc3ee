#pragma once

#include <string>

/// The current local date and time in the system locale's formats, but always with a four-digit year.
class Clock {
 public:
  virtual ~Clock() = default;

  virtual std::string ShortDate() const = 0;
  virtual std::string ShortTime() const = 0;

  /// Local date and time as the databases store them: "YYYY-MM-DD HH:MM:SS".
  virtual std::string Now() const = 0;

  /// The date in `text` (a short date, optionally followed by a time) in the locale's long format; `text`
  /// unchanged if there is none.
  virtual std::string LongDate(const std::string& text) const = 0;

  /// The date and time in `text` (a short date, then a short time or nothing) as Now tells them; empty if it
  /// is no such text.
  virtual std::string Stamp(const std::string& text) const = 0;
};
