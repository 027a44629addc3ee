#pragma once

#include <string>
#include <vector>

/// An address of this computer in a network.
struct LocalAddress {
  std::string Address;            ///< in digits: "192.168.1.5"
  std::string Interface;          ///< the system's name of the card: "wlan0"
  bool IsOfDefaultRoute = false;  ///< packets to the internet leave by this card

  bool operator==(const LocalAddress&) const = default;
};

/// The addresses of this computer.
class LocalAddresses {
 public:
  virtual ~LocalAddresses() = default;

  /// Those that no packet from the internet comes to: of private and local networks, and the computer's own,
  /// which stands last. Of IPv4 alone. Empty if the system does not tell.
  virtual std::vector<LocalAddress> Private() const = 0;
};
