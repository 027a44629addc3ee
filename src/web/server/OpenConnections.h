#pragma once

#include <chrono>
#include <cstddef>
#include <list>
#include <map>
#include <string>

/// The connections that are open, and which of them have to go: those that used up their time, and where
/// there is no more room those that waited longest.
class OpenConnections {
 public:
  using Time = std::chrono::steady_clock::time_point;

  struct Limits {
    unsigned InAll = 1024;
    unsigned OfAddress = 512;
    std::chrono::seconds First{10};    ///< until the head of the first request is there
    std::chrono::seconds Request{30};  ///< from the end of one answer to the end of the next
  };

  struct Connection {
    int Handle;  ///< its socket
    std::string Address;
    Time Since;                  ///< end of its last answer
    bool HasAsked = false;       ///< the head of a request was there
    bool IsEnded = false;        ///< it only has to be cleared away
    std::size_t PathLength = 0;  ///< of its last request, with the query, up to a zero byte
  };
  using Place = std::list<Connection>::iterator;

  explicit OpenConnections(const Limits& limits) : limits_(limits) {}

  /// Where the connections of the address, or all, are as many as may be, one is ended: of that address, or
  /// of the address that has most; the one that waited longest, and rather one that never asked for anything.
  Place Add(int handle, const std::string& address, Time now);

  void Remove(Place place);

  /// Ends those that used up their time.
  void EndSlowOnes(Time now);

  /// With those that are ended and not yet removed.
  std::size_t Count() const { return open_.size(); }

 private:
  void MakeRoom(const std::string& address);
  void EndLongestWaiting(const std::string& address);
  void End(Connection& connection);
  void Release(Connection& connection);

  Limits limits_;
  std::list<Connection> open_;
  std::map<std::string, unsigned> held_;  ///< of each address, those that are not ended
  unsigned heldInAll_ = 0;
};
