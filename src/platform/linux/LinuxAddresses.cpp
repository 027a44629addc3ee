#include "platform/linux/LinuxAddresses.h"

#include <arpa/inet.h>
#include <ifaddrs.h>
#include <net/if.h>
#include <netinet/in.h>

#include <algorithm>
#include <array>
#include <cstring>
#include <fstream>
#include <limits>
#include <memory>
#include <sstream>

namespace {

struct PrivateRange {
  std::uint32_t Address;
  unsigned Bits;
};

constexpr std::array PrivateRanges{PrivateRange{0x0A000000, 8}, PrivateRange{0x7F000000, 8},
                                   PrivateRange{0xA9FE0000, 16}, PrivateRange{0xAC100000, 12},
                                   PrivateRange{0xC0A80000, 16}};

std::string TableOfRoutes() {
  std::ifstream file("/proc/net/route");
  std::ostringstream text;
  text << file.rdbuf();
  return text.str();
}

}  // namespace

bool IsPrivateAddress(std::uint32_t address) {
  return std::ranges::any_of(PrivateRanges, [address](const PrivateRange& range) {
    return (address ^ range.Address) >> (32 - range.Bits) == 0;
  });
}

std::string DefaultInterface(const std::string& routes) {
  std::istringstream lines(routes);
  std::string line;
  std::getline(lines, line);  // the headings
  std::string best;
  unsigned long lowest = std::numeric_limits<unsigned long>::max();
  while (std::getline(lines, line)) {
    std::istringstream words(line);
    std::string card;
    std::string target;
    std::string word;
    unsigned long metric = 0;
    std::string mask;
    words >> card >> target >> word >> word >> word >> word >> metric >> mask;
    const bool isDefault = words && target == "00000000" && mask == "00000000";
    if (isDefault && metric < lowest) {
      lowest = metric;
      best = card;
    }
  }
  return best;
}

std::vector<LocalAddress> LinuxAddresses::Private() const {
  ifaddrs* first = nullptr;
  if (getifaddrs(&first) != 0) {
    return {};
  }
  const std::unique_ptr<ifaddrs, decltype(&freeifaddrs)> list(first, &freeifaddrs);
  const std::string defaultCard = DefaultInterface(TableOfRoutes());
  std::vector<LocalAddress> addresses;
  for (const ifaddrs* entry = first; entry != nullptr; entry = entry->ifa_next) {
    const bool isUsable = entry->ifa_addr != nullptr && entry->ifa_addr->sa_family == AF_INET &&
                          (entry->ifa_flags & IFF_UP) != 0 && (entry->ifa_flags & IFF_RUNNING) != 0;
    if (!isUsable) {
      continue;
    }
    sockaddr_in internet{};
    std::memcpy(&internet, entry->ifa_addr, sizeof internet);
    std::array<char, INET_ADDRSTRLEN> digits{};
    inet_ntop(AF_INET, &internet.sin_addr, digits.data(), digits.size());
    if (IsPrivateAddress(ntohl(internet.sin_addr.s_addr))) {
      addresses.push_back({.Address = digits.data(),
                           .Interface = entry->ifa_name,
                           .IsOfDefaultRoute = defaultCard == entry->ifa_name});
    }
  }
  std::stable_partition(addresses.begin(), addresses.end(),
                        [](const LocalAddress& each) { return !each.Address.starts_with("127."); });
  return addresses;
}
