#pragma once

#include <optional>
#include <string>

/// Name of the program that has locked the serial line `device` for itself by a file "LCK..NAME" in the
/// folder `locks`, as programs do that let others know. Nothing where there is no such file, where it was
/// left by a program that has ended, or where the program is this one. `processes` is the folder in which the
/// system lists them.
std::optional<std::string> LockHolder(const std::string& device, const std::string& locks,
                                      const std::string& processes);
