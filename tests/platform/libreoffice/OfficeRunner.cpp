#include <unistd.h>

#include <cstdlib>

#include "platform/libreoffice/LibreOffice.h"

/// office-runner FOLDER DESCRIPTOR: starts LibreOffice, writes one byte to DESCRIPTOR when it is ready, and
/// then does nothing.
int main(int argc, char** argv) {
  if (argc != 3) {
    return 2;
  }
  LibreOffice office(argv[1]);
  office.Start();
  constexpr int pollMicroseconds = 10000;
  while (office.State() == WordState::Starting) {
    usleep(pollMicroseconds);
  }
  if (office.State() == WordState::Ready && write(std::atoi(argv[2]), "", 1) == 1) {
    pause();
  }
  return 1;
}
