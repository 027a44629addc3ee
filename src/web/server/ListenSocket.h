#pragma once

#include "web/server/Peers.h"

/// How many ports from the wanted one on are tried when others have taken them.
inline constexpr int TriedPorts = 20;

/// A socket that listens at `served`, and the port that it got.
struct ListenSocket {
  int Handle = -1;  ///< negative where none could be had
  ServedAddress Served;
};

/// Listens at the wanted port or the next free one. Private addresses only.
ListenSocket Listen(const ServedAddress& wanted);
