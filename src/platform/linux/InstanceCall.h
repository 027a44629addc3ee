#pragma once

#include <optional>
#include <string>
#include <utility>

#include "platform/linux/Descriptor.h"
#include "platform/linux/InstanceLine.h"

/// Another start of the program that has called the running one. Nothing here waits.
class InstanceCall {
 public:
  enum class State {
    Pending,   ///< more of its line is to come
    Complete,  ///< the request is there
    Refused    ///< it will never be: hang up
  };

  /// The next call at a listening socket: none if nobody calls or the caller is another user's. `failed` is
  /// set when the system refuses to take calls for now.
  static std::optional<InstanceCall> Accept(int listener, bool& failed);

  explicit InstanceCall(Descriptor connection) : connection_(std::move(connection)) {}

  /// Readable when there is something to read.
  int Number() const { return connection_.Number(); }

  /// Reads what has arrived.
  State Read();

  const InstanceRequest& Request() const { return request_; }

  /// Tells the caller that the request is taken. False if the caller has gone: then it has told its user that
  /// nobody answers, and the request is void.
  bool Answer() const;

 private:
  State Check();

  Descriptor connection_;
  std::string received_;
  InstanceRequest request_;
};
