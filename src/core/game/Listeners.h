#pragma once

#include <functional>
#include <memory>
#include <utility>
#include <vector>

/// Keeps a listener subscribed while this object exists. May outlive the Listeners.
class [[nodiscard]] Subscription {
 public:
  Subscription() = default;
  explicit Subscription(std::shared_ptr<bool> listening) : listening_(std::move(listening)) {}
  Subscription(Subscription&&) = default;
  Subscription& operator=(Subscription&& other) noexcept {
    End();
    listening_ = std::move(other.listening_);
    return *this;
  }
  ~Subscription() { End(); }

  void End() {
    if (listening_) {
      *listening_ = false;
      listening_.reset();
    }
  }

 private:
  std::shared_ptr<bool> listening_;  ///< keeps the listener alive
};

/// The listeners to one kind of message, called in the order in which they subscribed. While a message is
/// being delivered, listeners may end and new ones may subscribe: one that has ended is not called any more,
/// and a new one first gets the next message. Listeners must not throw.
template <typename Message>
class Listeners {
 public:
  using Listener = std::function<void(const Message&)>;

  Subscription Listen(Listener listener) {
    const auto entry = std::make_shared<Entry>(Entry{true, std::move(listener)});
    entries_.push_back(entry);
    return Subscription(std::shared_ptr<bool>(entry, &entry->Listening));
  }

  void Tell(const Message& message) {
    std::erase_if(entries_, [](const std::weak_ptr<Entry>& entry) { return entry.expired(); });
    const std::vector<std::weak_ptr<Entry>> present = entries_;
    for (const std::weak_ptr<Entry>& held : present) {
      const std::shared_ptr<Entry> entry = held.lock();
      // One that ended during its own call still exists.
      if (entry && entry->Listening) {
        entry->Hear(message);
      }
    }
  }

 private:
  struct Entry {
    bool Listening;
    Listener Hear;
  };

  std::vector<std::weak_ptr<Entry>> entries_;  ///< expired for listeners that have ended
};
