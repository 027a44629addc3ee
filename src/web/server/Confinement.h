#pragma once

#include <cstddef>

/// Gives up, for the rest of the process, what serving pages does not need: other users' rights, further
/// programs and processes, files, new sockets, and more memory or handles than `handles` and some. Returns
/// false if the system refuses one of them.
bool Confine(std::size_t handles);

/// How many handles the system lets this process have at most.
std::size_t MostHandles();
