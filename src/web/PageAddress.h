#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "platform/LocalAddresses.h"

/// The address at which the pages are to be served: the one that is set, as long as the computer has it; if
/// none is set, that of the default route, else the first one of a network. Empty if there is none such.
std::string AddressToServe(const std::vector<LocalAddress>& addresses, const std::string& wanted);

/// What phones are to open: "http://192.168.1.20:8080/".
std::string UrlOfPages(const std::string& address, std::uint16_t port);
