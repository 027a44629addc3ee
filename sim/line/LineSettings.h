#pragma once

#include <string>
#include <vector>

namespace sim {

/// Speed and format at one end of a serial line.
struct LineSettings {
  int Baud = 9600;  ///< bits per second
  int DataBits = 8;
  char Parity = 'N';  ///< N none, E even, O odd, M mark, S space
  int StopBits = 1;

  bool operator==(const LineSettings&) const = default;
};

/// "19200,8N1".
std::string Text(const LineSettings& settings);
/// "19200,8N1 or 115200,8N1".
std::string Text(const std::vector<LineSettings>& settings);

/// The settings in a terminal's control flags, at `baud`. The pseudo terminal driver forces eight data bits
/// and drops the request for parity, but not its kind (CSIZE and PARENB are lost, PARODD and CMSPAR are
/// kept). So odd, mark and space parity are recognised by the kept flags alone. Seven data bits and even
/// parity are recognised on terminals that keep them; on a pseudo terminal they cannot be.
LineSettings LineSettingsFrom(unsigned int controlFlags, int baud);

/// The settings of the terminal `descriptor`, as left by the latest tcsetattr at either end. They outlast the
/// client: they still apply while nobody has the terminal open, and to the next client if it sets none.
/// Throws std::system_error.
LineSettings ReadLineSettings(int descriptor);

/// Makes the terminal raw, at `settings`. Throws std::system_error, and std::invalid_argument for a speed
/// that terminals have no code for.
void SetRawLine(int descriptor, const LineSettings& settings);

}  // namespace sim
