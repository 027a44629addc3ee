#include "web/server/ServerLoop.h"

#include <fcntl.h>
#include <malloc.h>
#include <poll.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <cstring>

ServerLoop::ServerLoop(int input, int output, PageHost& host, ServedPages& pages, Visitors& visitors)
    : input_(input), output_(output), host_(host), pages_(pages), visitors_(visitors) {
  fcntl(output_, F_SETFL, fcntl(output_, F_GETFL) | O_NONBLOCK);  // a parent that does not read delays nobody
}

ServerEnd ServerLoop::Run(std::uint16_t port) {
  Report({.Kind = ReportKind::Port, .Number = port});
  for (;;) {
    std::array<pollfd, 2> waits{pollfd{.fd = input_, .events = POLLIN, .revents = 0},
                                pollfd{.fd = host_.Handle(), .events = POLLIN, .revents = 0}};
    poll(waits.data(), waits.size(), PauseInMilliseconds());
    if (waits[0].revents != 0) {
      if (const auto end = TakeOrders()) {
        return *end;
      }
    }
    host_.Run();
    const Visitors::Time now = std::chrono::steady_clock::now();
    if (now - lastSecond_ >= std::chrono::seconds(1)) {
      lastSecond_ = now;
      host_.EndSlowOnes(now);
      ReportVisitors();
    }
  }
}

std::optional<ServerEnd> ServerLoop::TakeOrders() {
  std::array<char, 64UL * 1024> bytes{};
  const ssize_t count = read(input_, bytes.data(), bytes.size());
  if (count < 0 && (errno == EINTR || errno == EAGAIN)) {
    return std::nullopt;
  }
  if (count <= 0) {
    return ServerEnd::ParentGone;
  }
  orders_.Add({bytes.data(), static_cast<std::size_t>(count)});
  explicit_bzero(bytes.data(), static_cast<std::size_t>(count));
  while (auto frame = orders_.Next()) {
    const bool show = frame->Order == PageOrder::Show;
    if (!pages_.Take(std::move(*frame))) {
      return ServerEnd::BadOrders;
    }
    if (show) {
      host_.Forget();
      malloc_trim(0);  // the old pages' memory may lie between that of the new ones
    }
  }
  return orders_.Broken() ? std::optional(ServerEnd::BadOrders) : std::nullopt;
}

void ServerLoop::Report(const PageReport& report) const {
  const std::string bytes = EncodeReport(report);
  // At most 5 bytes: a pipe takes them whole or not at all. One that is lost is followed by others.
  static_cast<void>(!write(output_, bytes.data(), bytes.size()));
}

void ServerLoop::ReportVisitors() {
  const std::uint32_t count = visitors_.Count(std::chrono::steady_clock::now());
  if (count != reported_) {
    reported_ = count;
    Report({.Kind = ReportKind::Visitors, .Number = count});
  }
}

int ServerLoop::PauseInMilliseconds() const {
  constexpr std::int64_t second = 1000;
  const std::int64_t due = host_.Due().count();
  const bool watching = host_.Connections() > 0 || visitors_.Any() || reported_ > 0;
  if (!watching) {
    return static_cast<int>(std::min<std::int64_t>(due, 60 * second));
  }
  return static_cast<int>(due < 0 ? second : std::min(due, second));
}
