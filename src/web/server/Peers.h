#pragma once

#include <sys/socket.h>

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

/// An address of this computer and a port.
struct ServedAddress {
  std::string Address;     ///< in digits: "192.168.1.5", "fd00::1"
  std::uint16_t Port = 0;  ///< 1 to 65535
};

/// An address as the system's calls take it.
struct SocketAddress {
  sockaddr_storage Storage{};
  socklen_t Length = 0;
};

/// None if the text is no address in digits.
std::optional<SocketAddress> SocketAddressOf(const ServedAddress& served);

/// True for addresses that no packet from the internet comes from: private and local networks, and this
/// computer's own.
bool IsPrivate(const sockaddr& address);

/// The address without its port, alike for all connections of one device; empty for a family that is none of
/// the internet's.
std::string AddressKey(const sockaddr& address);

/// What a browser that was sent to `served` writes as Host, in small letters.
std::vector<std::string> HostsOf(const ServedAddress& served);
