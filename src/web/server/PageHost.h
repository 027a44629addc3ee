#pragma once

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <memory>

#include "web/server/ListenSocket.h"
#include "web/server/ServedPages.h"
#include "web/server/Visitors.h"

/// Answers browsers with the pages in memory. Nothing of what they send is kept but their address, for a
/// minute, and nothing of it is read but the method, the path, and who they think we are.
class PageHost {
 public:
  struct Limits {
    unsigned Connections = 1024;       ///< more than Spare
    unsigned OfAddress = 512;          ///< phones behind one access point may share an address
    std::size_t Head = 6UL * 1024;     ///< bytes for the head of a request and that of its answer
    std::chrono::seconds First{10};    ///< until the head of the first request is there
    std::chrono::seconds Request{30};  ///< from the end of one answer to the end of the next
  };

  /// When all connections but these are taken, or all of an address, whoever comes takes the place of the
  /// connection that has waited longest: of its own address, or of the one that has most.
  static constexpr unsigned Spare = 32;

  /// Takes `socket` over. All others must outlive this.
  PageHost(const ListenSocket& socket, const ServedPages& pages, Visitors& visitors)
      : PageHost(socket, pages, visitors, {}) {}
  PageHost(const ListenSocket& socket, const ServedPages& pages, Visitors& visitors, const Limits& limits);
  ~PageHost();
  PageHost(const PageHost&) = delete;
  PageHost& operator=(const PageHost&) = delete;

  /// False if it could not begin.
  bool Serving() const;

  /// Becomes readable when Run has something to do.
  int Handle() const;

  /// Does what there is to do, without waiting.
  void Run();

  /// Time after which Run is due although nothing came; negative for never.
  std::chrono::milliseconds Due() const;

  /// Ends connections that used up their time.
  void EndSlowOnes(Visitors::Time now);

  std::size_t Connections() const;

  /// The pages have changed.
  void Forget();

 private:
  class Daemon;
  std::unique_ptr<Daemon> daemon_;
};
