#pragma once

#include <cstdint>
#include <optional>

#include "web/server/PageHost.h"

/// How the program ends.
enum class ServerEnd : int {
  ParentGone = 0,   ///< the stream of orders is closed
  BadOrders = 2,    ///< the stream holds what no order is, or pages beyond the limits
  NoAddress = 3,    ///< nothing can be served at the address
  NotConfined = 4,  ///< the system refuses to take the rights away
  BadWords = 5      ///< not called with an address and a port
};

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
