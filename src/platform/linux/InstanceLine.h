#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>

/// What a start of the program asks of the one that runs already.
struct InstanceRequest {
  std::string Path;   ///< absolute, of a game to load; empty to come to the front only
  std::string Token;  ///< the desktop's permission to come to the front; may be empty

  bool operator==(const InstanceRequest&) const = default;
};

/// Bytes of a request, its line break among them.
inline constexpr std::size_t LongestInstanceLine = 8192;

/// The request as one line, with its line break; none if it were too long. A relative path is refused too.
std::optional<std::string> InstanceLine(const InstanceRequest& request);

/// Reads a line without its line break. None unless it is one that InstanceLine can have made.
std::optional<InstanceRequest> ReadInstanceLine(std::string_view line);
