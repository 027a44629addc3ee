#include "web/PageAddress.h"

#include <algorithm>

namespace {

bool IsOwn(const LocalAddress& each) {
  return each.Address.starts_with("127.");
}

}  // namespace

std::string AddressToServe(const std::vector<LocalAddress>& addresses, const std::string& wanted) {
  if (!wanted.empty()) {
    return std::ranges::find(addresses, wanted, &LocalAddress::Address) != addresses.end() ? wanted
                                                                                           : std::string();
  }
  auto found = std::ranges::find_if(
      addresses, [](const LocalAddress& each) { return each.IsOfDefaultRoute && !IsOwn(each); });
  if (found == addresses.end()) {
    found = std::ranges::find_if_not(addresses, IsOwn);
  }
  return found != addresses.end() ? found->Address : std::string();
}

std::string UrlOfPages(const std::string& address, std::uint16_t port) {
  std::string url = "http://";
  url.append(address).append(":").append(std::to_string(port)).append("/");
  return url;
}
