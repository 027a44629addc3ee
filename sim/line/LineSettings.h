#pragma once

#include <string>
#include <vector>

namespace sim {

/// How one end of a serial line speaks.
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

/// What the control flags of a terminal say, at `baud`. The driver of pseudo terminals forces eight data bits
/// and forgets that parity was asked for, but not which (CSIZE and PARENB are lost, PARODD and CMSPAR are
/// kept). So odd, mark and space parity are told by the kept flags alone. Seven data bits and even parity are
/// told where a terminal keeps them, and on a pseudo terminal nobody can tell them.
LineSettings LineSettingsFrom(unsigned int controlFlags, int baud);

/// As the latest tcsetattr at either end of the terminal `descriptor` has left them. They outlast the client:
/// a terminal that nobody has open, and the next client that sets nothing, have them still. Throws
/// std::system_error.
LineSettings ReadLineSettings(int descriptor);

/// Makes the terminal raw, at `settings`. Throws std::system_error, and std::invalid_argument for a speed
/// that terminals have no code for.
void SetRawLine(int descriptor, const LineSettings& settings);

}  // namespace sim
