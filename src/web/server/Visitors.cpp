#include "web/server/Visitors.h"

#include "web/PageStream.h"

void Visitors::Note(const std::string& address, Time now) {
  const auto known = seen_.find(address);
  if (known != seen_.end()) {
    known->second = now;
  } else if (seen_.size() < MostVisitors) {
    seen_.emplace(address, now);
  }
}

std::uint32_t Visitors::Count(Time now) {
  std::erase_if(seen_, [now](const auto& entry) { return now - entry.second >= Remembered; });
  return static_cast<std::uint32_t>(seen_.size());
}
