#pragma once

#include <cstddef>

/// A bar on the standard error, if that is a terminal.
class ProgressBar {
 public:
  ProgressBar();
  /// Ends the bar's line.
  ~ProgressBar();
  ProgressBar(const ProgressBar&) = delete;
  ProgressBar& operator=(const ProgressBar&) = delete;

  void Show(std::size_t done, std::size_t whole);

 private:
  bool isTerminal_;
  std::size_t percent_ = 101;  ///< as shown last
};
