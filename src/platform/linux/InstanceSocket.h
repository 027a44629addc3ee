#pragma once

#include <sys/socket.h>
#include <sys/un.h>

#include <optional>
#include <string>

#include "platform/linux/Descriptor.h"

/// The address of a local socket. Holds for any length of path.
class InstanceAddress {
 public:
  explicit InstanceAddress(const std::string& path);

  const sockaddr* Get() const { return reinterpret_cast<const sockaddr*>(&address_); }
  static constexpr socklen_t Size = sizeof(sockaddr_un);
  /// False where the folder cannot be opened.
  bool Valid() const { return valid_; }

 private:
  Descriptor folder_;  ///< of a path that is too long for an address
  sockaddr_un address_{};
  bool valid_ = false;
};

/// True if the process at the other end runs for this process's user.
bool IsOfThisUser(int socket);

/// What the running program answers to a request that it takes.
inline constexpr const char* InstanceAnswer = "taken\n";
