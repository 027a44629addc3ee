#pragma once

#include <optional>
#include <string>
#include <vector>

/// The sound events that a product's definition file names, in its order; an entry without a name is "0".
/// Nullopt if the bytes are not well-formed or not such a file.
std::optional<std::vector<std::string>> ReadSoundDefinition(std::string bytes);
