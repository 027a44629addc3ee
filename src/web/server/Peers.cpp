#include "web/server/Peers.h"

#include <arpa/inet.h>
#include <netinet/in.h>

#include <array>
#include <cstring>

namespace {

struct Network {
  std::uint32_t Address;
  unsigned Bits;
};

constexpr std::array PrivateNetworks{Network{0x0A000000, 8}, Network{0x7F000000, 8}, Network{0xA9FE0000, 16},
                                     Network{0xAC100000, 12}, Network{0xC0A80000, 16}};

bool IsPrivate4(std::uint32_t address) {
  for (const Network& network : PrivateNetworks) {
    if ((address ^ network.Address) >> (32 - network.Bits) == 0) {
      return true;
    }
  }
  return false;
}

using Address6 = std::array<std::uint8_t, 16>;

bool HoldsAddress4(const Address6& bytes) {
  constexpr std::array<std::uint8_t, 12> start{0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0xFF, 0xFF};
  return std::memcmp(bytes.data(), start.data(), start.size()) == 0;
}

bool IsPrivate6(const Address6& bytes) {
  if (HoldsAddress4(bytes)) {
    std::uint32_t address = 0;
    std::memcpy(&address, &bytes[12], sizeof address);
    return IsPrivate4(ntohl(address));
  }
  constexpr Address6 own{0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 1};
  const bool unique = (bytes[0] & 0xFEU) == 0xFC;
  const bool link = bytes[0] == 0xFE && (bytes[1] & 0xC0U) == 0x80;
  return unique || link || bytes == own;
}

std::uint32_t Address4Of(const sockaddr& address) {
  sockaddr_in internet{};
  std::memcpy(&internet, &address, sizeof internet);
  return ntohl(internet.sin_addr.s_addr);
}

Address6 Address6Of(const sockaddr& address) {
  sockaddr_in6 internet{};
  std::memcpy(&internet, &address, sizeof internet);
  Address6 bytes{};
  std::memcpy(bytes.data(), &internet.sin6_addr, bytes.size());
  return bytes;
}

}  // namespace

std::optional<SocketAddress> SocketAddressOf(const ServedAddress& served) {
  SocketAddress result;
  sockaddr_in internet{};
  sockaddr_in6 internet6{};
  if (inet_pton(AF_INET, served.Address.c_str(), &internet.sin_addr) == 1) {
    internet.sin_family = AF_INET;
    internet.sin_port = htons(served.Port);
    result.Length = sizeof internet;
    std::memcpy(&result.Storage, &internet, sizeof internet);
    return result;
  }
  if (inet_pton(AF_INET6, served.Address.c_str(), &internet6.sin6_addr) == 1) {
    internet6.sin6_family = AF_INET6;
    internet6.sin6_port = htons(served.Port);
    result.Length = sizeof internet6;
    std::memcpy(&result.Storage, &internet6, sizeof internet6);
    return result;
  }
  return std::nullopt;
}

bool IsPrivate(const sockaddr& address) {
  switch (address.sa_family) {
    case AF_INET:
      return IsPrivate4(Address4Of(address));
    case AF_INET6:
      return IsPrivate6(Address6Of(address));
    default:
      return false;
  }
}

std::string AddressKey(const sockaddr& address) {
  std::string key;
  if (address.sa_family == AF_INET) {
    const std::uint32_t number = Address4Of(address);
    for (unsigned shift = 0; shift < 32; shift += 8) {
      key += static_cast<char>((number >> shift) & 0xFFU);
    }
  } else if (address.sa_family == AF_INET6) {
    for (const std::uint8_t byte : Address6Of(address)) {
      key += static_cast<char>(byte);
    }
  }
  return key;
}

std::vector<std::string> HostsOf(const ServedAddress& served) {
  const bool bracketed = served.Address.find(':') != std::string::npos;
  std::vector<std::string> names{bracketed ? "[" + served.Address + "]" : served.Address};
  if (served.Address == "127.0.0.1" || served.Address == "::1") {
    names.emplace_back("localhost");
  }
  std::vector<std::string> hosts;
  for (const std::string& name : names) {
    hosts.push_back(name + ":" + std::to_string(served.Port));
    if (served.Port == 80) {
      hosts.push_back(name);
    }
  }
  return hosts;
}
