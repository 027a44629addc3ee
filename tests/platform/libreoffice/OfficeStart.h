#pragma once

#include <chrono>
#include <functional>
#include <thread>

#include "platform/libreoffice/LibreOffice.h"

/// Polls `condition` until it is true; returns false after a minute.
inline bool WaitUntil(const std::function<bool()>& condition) {
  const auto end = std::chrono::steady_clock::now() + std::chrono::seconds(60);
  while (!condition()) {
    if (std::chrono::steady_clock::now() > end) {
      return false;
    }
    std::this_thread::sleep_for(std::chrono::milliseconds(10));
  }
  return true;
}

inline bool StartAndWait(LibreOffice& office) {
  office.Start();
  return WaitUntil([&] { return office.State() != WordState::Starting; }) &&
         office.State() == WordState::Ready;
}
