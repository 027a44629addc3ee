#pragma once

#include "web/server/Peers.h"

/// True if the pages are answered with at the address within some seconds. Asks once.
bool IsAnswered(const ServedAddress& served);
