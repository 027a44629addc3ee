#pragma once

#include <vector>

#include "platform/LocalAddresses.h"

/// Addresses that a test gives.
class FakeLocalAddresses : public LocalAddresses {
 public:
  std::vector<LocalAddress> List = {
      {.Address = "192.168.1.20", .Interface = "wlan0", .IsOfDefaultRoute = true},
      {.Address = "127.0.0.1", .Interface = "lo"}};

  std::vector<LocalAddress> Private() const override { return List; }
};
