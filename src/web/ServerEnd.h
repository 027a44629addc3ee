#pragma once

/// How the program that serves the pages ends: its exit code.
enum class ServerEnd : int {
  ParentGone = 0,   ///< the stream of orders is closed
  BadOrders = 2,    ///< the stream holds what no order is, or pages beyond the limits
  NoAddress = 3,    ///< nothing can be served at the address
  NotConfined = 4,  ///< the system refuses to take the rights away, or grants too few handles
  BadWords = 5      ///< not called with an address and a port
};
