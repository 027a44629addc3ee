#include "web/server/OpenConnections.h"

#include <sys/socket.h>

#include <algorithm>
#include <utility>

OpenConnections::Place OpenConnections::Add(int handle, const std::string& address, Time now) {
  MakeRoom(address);
  ++held_[address];
  ++heldInAll_;
  open_.push_front({.Handle = handle, .Address = address, .Since = now});
  return open_.begin();
}

void OpenConnections::Remove(Place place) {
  Release(*place);
  open_.erase(place);
}

void OpenConnections::EndSlowOnes(Time now) {
  for (Connection& connection : open_) {
    const std::chrono::seconds most = connection.HasAsked ? limits_.Request : limits_.First;
    if (!connection.IsEnded && now - connection.Since >= most) {
      End(connection);
    }
  }
}

void OpenConnections::MakeRoom(const std::string& address) {
  const auto own = held_.find(address);
  if (own != held_.end() && own->second >= limits_.OfAddress) {
    EndLongestWaiting(address);
  } else if (heldInAll_ >= limits_.InAll) {
    const auto most = std::ranges::max_element(held_, {}, [](const auto& entry) { return entry.second; });
    const std::string fullest = most->first;  // the entry may go with its last connection
    EndLongestWaiting(fullest);
  }
}

void OpenConnections::EndLongestWaiting(const std::string& address) {
  const auto rank = [](const Connection& each) { return std::pair(each.HasAsked, each.Since); };
  Connection* longest = nullptr;
  for (Connection& each : open_) {
    const bool mayGo = !each.IsEnded && each.Address == address;
    if (mayGo && (longest == nullptr || rank(each) < rank(*longest))) {
      longest = &each;
    }
  }
  if (longest != nullptr) {
    End(*longest);
  }
}

void OpenConnections::End(Connection& connection) {
  Release(connection);
  shutdown(connection.Handle, SHUT_RDWR);
}

void OpenConnections::Release(Connection& connection) {
  if (std::exchange(connection.IsEnded, true)) {
    return;
  }
  --heldInAll_;
  const auto count = held_.find(connection.Address);
  if (--count->second == 0) {
    held_.erase(count);
  }
}
