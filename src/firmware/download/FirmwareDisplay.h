#pragma once

#include <cstdint>
#include <string>

/// The window of a firmware download. It only displays.
class FirmwareDisplay {
 public:
  virtual ~FirmwareDisplay() = default;

  virtual void SetStatus(const std::string& text) = 0;
  /// The state of the download.
  virtual void SetDownload(const std::string& text) = 0;
  virtual void SetCurrentBuffer(const std::string& text) = 0;
  /// The digits of the line that are not converted yet.
  virtual void SetDigits(const std::string& text) = 0;
  /// Fills the bar to a share of its width; up to 1.
  virtual void SetBar(double share) = 0;
  /// Green or red.
  virtual void SetLamps(bool connected, bool complete) = 0;
  virtual void SetBreakCaption(const std::string& caption) = 0;
  /// Browse and Download are enabled while no download runs, Break while one does.
  virtual void EnableButtons(bool running) = 0;

  /// The hourglass.
  virtual void SetBusy(bool busy) = 0;
  /// `sent` of `all` bytes are on the line, not counting what was sent twice.
  virtual void SetSent(std::uint64_t sent, std::uint64_t all) = 0;
  /// What the device is likely in and what to do; empty for nothing.
  virtual void SetAdvice(const std::string& text) = 0;
};
