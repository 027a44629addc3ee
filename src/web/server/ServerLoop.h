#pragma once

#include <cstdint>
#include <optional>

#include "web/ServerEnd.h"
#include "web/server/PageHost.h"

/// Serves pages: orders come at `input`, reports leave at `output`, and both are left open.
class ServerLoop {
 public:
  ServerLoop(int input, int output, PageHost& host, ServedPages& pages, Visitors& visitors);

  /// Until the stream of orders ends or is broken.
  ServerEnd Run(std::uint16_t port);

 private:
  /// How the program ends, if it does.
  std::optional<ServerEnd> TakeOrders();
  void Report(const PageReport& report) const;
  void ReportVisitors();
  int PauseInMilliseconds() const;

  int input_;
  int output_;
  PageHost& host_;
  ServedPages& pages_;
  Visitors& visitors_;
  PageFrameReader orders_;
  std::uint32_t reported_ = 0;
  Visitors::Time lastSecond_{};
};
