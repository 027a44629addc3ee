#pragma once

#include <cstdint>
#include <string>

#include "platform/LocalAddresses.h"

class LinuxAddresses : public LocalAddresses {
 public:
  std::vector<LocalAddress> Private() const override;
};

/// True for an address (first byte highest) of a private or local network, or the computer's own.
bool IsPrivateAddress(std::uint32_t address);

/// The card of the default route with the lowest metric in the kernel's table of routes; empty without one.
std::string DefaultInterface(const std::string& routes);
