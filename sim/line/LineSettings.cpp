#include "sim/line/LineSettings.h"

// The kernel's own header, which cannot be combined with <termios.h>: only it has the speed as a number.
#include <asm/termbits.h>
#include <sys/ioctl.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <stdexcept>
#include <system_error>

namespace sim {
namespace {

struct SpeedCode {
  int Baud;
  unsigned int Code;
};

constexpr std::array<SpeedCode, 11> SpeedCodes{{{300, B300},
                                                {600, B600},
                                                {1200, B1200},
                                                {2400, B2400},
                                                {4800, B4800},
                                                {9600, B9600},
                                                {19200, B19200},
                                                {38400, B38400},
                                                {57600, B57600},
                                                {115200, B115200},
                                                {230400, B230400}}};

unsigned int SpeedCodeOf(int baud) {
  const auto* found = std::find_if(SpeedCodes.begin(), SpeedCodes.end(),
                                   [&](const SpeedCode& candidate) { return candidate.Baud == baud; });
  if (found == SpeedCodes.end()) {
    throw std::invalid_argument("Terminals do not run at " + std::to_string(baud) + " bits per second");
  }
  return found->Code;
}

int DataBitsOf(unsigned int controlFlags) {
  switch (controlFlags & CSIZE) {
    case CS5:
      return 5;
    case CS6:
      return 6;
    case CS7:
      return 7;
    default:
      return 8;
  }
}

char ParityOf(unsigned int controlFlags) {
  const bool odd = (controlFlags & PARODD) != 0;
  if ((controlFlags & CMSPAR) != 0) {
    return odd ? 'M' : 'S';
  }
  if (odd) {
    return 'O';
  }
  return (controlFlags & PARENB) != 0 ? 'E' : 'N';
}

unsigned int SizeFlagsOf(int dataBits) {
  constexpr std::array<unsigned int, 4> flags{CS5, CS6, CS7, CS8};
  return flags.at(static_cast<std::size_t>(dataBits - 5));
}

unsigned int ParityFlagsOf(char parity) {
  switch (parity) {
    case 'E':
      return PARENB;
    case 'O':
      return PARENB | PARODD;
    case 'M':
      return PARENB | PARODD | CMSPAR;
    case 'S':
      return PARENB | CMSPAR;
    default:
      return 0;
  }
}

termios2 Read(int descriptor) {
  termios2 terminal{};
  if (::ioctl(descriptor, TCGETS2, &terminal) != 0) {
    throw std::system_error(errno, std::generic_category(), "settings of a line");
  }
  return terminal;
}

}  // namespace

std::string Text(const LineSettings& settings) {
  return std::to_string(settings.Baud) + ',' + std::to_string(settings.DataBits) + settings.Parity +
         std::to_string(settings.StopBits);
}

std::string Text(const std::vector<LineSettings>& settings) {
  std::string text;
  for (const LineSettings& next : settings) {
    text += (text.empty() ? "" : " or ") + Text(next);
  }
  return text;
}

LineSettings LineSettingsFrom(unsigned int controlFlags, int baud) {
  return {.Baud = baud,
          .DataBits = DataBitsOf(controlFlags),
          .Parity = ParityOf(controlFlags),
          .StopBits = (controlFlags & CSTOPB) != 0 ? 2 : 1};
}

LineSettings ReadLineSettings(int descriptor) {
  const termios2 terminal = Read(descriptor);
  return LineSettingsFrom(terminal.c_cflag, static_cast<int>(terminal.c_ospeed));
}

void SetRawLine(int descriptor, const LineSettings& settings) {
  termios2 terminal = Read(descriptor);
  terminal.c_iflag &=
      ~static_cast<tcflag_t>(IGNBRK | BRKINT | PARMRK | ISTRIP | INLCR | IGNCR | ICRNL | IXON);
  terminal.c_oflag &= ~static_cast<tcflag_t>(OPOST);
  terminal.c_lflag &= ~static_cast<tcflag_t>(ECHO | ECHONL | ICANON | ISIG | IEXTEN);
  terminal.c_cflag &= ~static_cast<tcflag_t>(CBAUD | CSIZE | PARENB | PARODD | CMSPAR | CSTOPB);
  terminal.c_cflag |= SpeedCodeOf(settings.Baud) | SizeFlagsOf(settings.DataBits) |
                      ParityFlagsOf(settings.Parity) | (settings.StopBits == 2 ? CSTOPB : 0U);
  if (::ioctl(descriptor, TCSETS2, &terminal) != 0) {
    throw std::system_error(errno, std::generic_category(), "settings of a line");
  }
}

}  // namespace sim
