#include "firmware/pic24f/tool/ProgressBar.h"

#include <unistd.h>

#include <cstdio>
#include <string>

ProgressBar::ProgressBar() : isTerminal_(isatty(STDERR_FILENO) != 0) {}

ProgressBar::~ProgressBar() {
  if (percent_ <= 100) {
    std::fputc('\n', stderr);
  }
}

void ProgressBar::Show(std::size_t done, std::size_t whole) {
  if (!isTerminal_ || whole == 0 || done > whole) {
    return;
  }
  const std::size_t percent = 100 * done / whole;
  if (percent == percent_) {
    return;
  }
  percent_ = percent;
  constexpr std::size_t width = 50;
  const std::size_t full = percent * width / 100;
  const std::string bar = std::string(full, '#') + std::string(width - full, ' ');
  std::fprintf(stderr, "\r[%s] %3zu %%", bar.c_str(), percent);
  std::fflush(stderr);
}
