#include "bench/PagePhones.h"

#include <poll.h>

#include <algorithm>
#include <optional>
#include <stdexcept>
#include <string>

#include "bench/PageLoad.h"

namespace {

using Clock = std::chrono::steady_clock;
using namespace std::chrono_literals;

constexpr std::chrono::milliseconds ScriptPause = 3s;

/// The front page, its style and its script.
constexpr const char* WholePage[] = {"/", "/style.css", "/follow.js"};

std::string TokenOfPage(const std::string& page) {
  constexpr std::string_view mark = "data-now=\"";
  const std::size_t at = page.find(mark);
  if (at == std::string::npos) {
    return {};
  }
  const std::size_t start = at + mark.size();
  return page.substr(start, page.find('"', start) - start);
}

}  // namespace

class PagePhones::Phone {
 public:
  Phone(std::uint16_t port, Time first) : connection_(port), due_(first) {}

  int Handle() const { return connection_.Handle(); }
  bool HasFailed() const { return hasFailed_; }

  /// When it asks next; none while it waits for an answer.
  std::optional<Time> Due() const { return awaited_ == 0 ? std::optional(due_) : std::nullopt; }

  /// When it last had a whole page; none before the first.
  std::optional<Time> Loaded() const { return loaded_; }

  void Ask() {
    if (token_.empty()) {
      Load();
    } else {
      awaited_ = 1;
      connection_.Ask("/now");
    }
  }

  /// Takes what has come.
  void Read() {
    try {
      connection_.Receive();
      while (const auto body = connection_.NextBody()) {
        Take(*body);
      }
    } catch (const std::exception&) {
      hasFailed_ = true;
    }
  }

 private:
  void Load() {
    isLoading_ = true;
    awaited_ = std::size(WholePage);
    for (const char* path : WholePage) {
      connection_.Ask(path);
    }
  }

  void Take(const std::string& body) {
    --awaited_;
    if (!isLoading_) {
      if (body != token_) {
        Load();
        return;
      }
    } else if (awaited_ == std::size(WholePage) - 1) {
      token_ = TokenOfPage(body);
    }
    if (awaited_ == 0) {
      if (isLoading_) {
        loaded_ = Clock::now();
      }
      isLoading_ = false;
      due_ = Clock::now() + ScriptPause;
    }
  }

  PageConnection connection_;
  Time due_;
  std::string token_;  ///< of the page that it shows
  std::size_t awaited_ = 0;
  bool isLoading_ = false;
  std::optional<Time> loaded_;
  bool hasFailed_ = false;
};

PagePhones::PagePhones(std::uint16_t port, int count) {
  const Time now = Clock::now();
  for (int i = 0; i < count; ++i) {
    phones_.push_back(std::make_unique<Phone>(port, now + i * ScriptPause / count));
  }
}

PagePhones::~PagePhones() = default;

void PagePhones::GoOn(std::chrono::milliseconds time) {
  const Time end = Clock::now() + time;
  while (Clock::now() < end) {
    Turn(end);
  }
}

std::vector<double> PagePhones::NewPages(Time since, std::chrono::milliseconds time) {
  const Time end = Clock::now() + time;
  std::vector<double> times;
  while (times.size() + failures_ < phones_.size() && Clock::now() < end) {
    Turn(end);
    times.clear();
    for (const auto& phone : phones_) {
      if (const auto loaded = phone->Loaded(); loaded && *loaded > since) {
        times.push_back(std::chrono::duration<double>(*loaded - since).count());
      }
    }
  }
  std::ranges::sort(times);
  return times;
}

void PagePhones::Turn(Time until) {
  std::vector<pollfd> waits;
  Time next = until;
  failures_ = 0;
  for (const auto& phone : phones_) {
    if (phone->HasFailed()) {
      ++failures_;
    } else if (const auto due = phone->Due(); due && *due <= Clock::now()) {
      phone->Ask();
    } else if (due) {
      next = std::min(next, *due);
    }
    waits.push_back({.fd = phone->HasFailed() ? -1 : phone->Handle(), .events = POLLIN, .revents = 0});
  }
  const auto pause = std::chrono::ceil<std::chrono::milliseconds>(next - Clock::now());
  poll(waits.data(), waits.size(), static_cast<int>(std::max(pause, 0ms).count()));
  for (std::size_t at = 0; at < waits.size(); ++at) {
    if (waits[at].revents != 0) {
      phones_[at]->Read();
    }
  }
}
