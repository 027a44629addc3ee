#include "bench/PageLoad.h"

#include <arpa/inet.h>
#include <netinet/in.h>
#include <poll.h>
#include <sys/socket.h>
#include <unistd.h>

#include <array>
#include <memory>
#include <stdexcept>
#include <vector>

namespace {

using Clock = std::chrono::steady_clock;

}  // namespace

PageConnection::PageConnection(std::uint16_t port)
    : handle_(socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0)), port_(port) {
  sockaddr_in address{};
  address.sin_family = AF_INET;
  address.sin_port = htons(port);
  address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
  if (connect(handle_, reinterpret_cast<sockaddr*>(&address), sizeof address) != 0) {
    close(handle_);
    throw std::runtime_error("the server refuses a connection");
  }
}

PageConnection::~PageConnection() {
  close(handle_);
}

void PageConnection::Ask(const std::string& path) const {
  std::string request = "GET ";
  request.append(path)
      .append(" HTTP/1.1\r\nHost: 127.0.0.1:")
      .append(std::to_string(port_))
      .append("\r\n\r\n");
  send(handle_, request.data(), request.size(), MSG_NOSIGNAL);
}

void PageConnection::Receive() {
  static std::array<char, 65536> bytes;
  const ssize_t count = recv(handle_, bytes.data(), bytes.size(), 0);
  if (count <= 0) {
    throw std::runtime_error("a connection ended");
  }
  answers_.append(bytes.data(), static_cast<std::size_t>(count));
}

std::optional<std::string> PageConnection::NextBody() {
  constexpr std::string_view end = "\r\n\r\n";
  const std::size_t head = answers_.find(end);
  if (head == std::string::npos) {
    return std::nullopt;
  }
  constexpr std::string_view lengthName = "Content-Length: ";
  const std::size_t lengthAt = answers_.find(lengthName);
  if (!answers_.starts_with("HTTP/1.1 200 ") || lengthAt > head) {
    throw std::runtime_error("an answer is no page");
  }
  const std::size_t start = head + end.size();
  const std::size_t length = std::stoul(answers_.substr(lengthAt + lengthName.size(), 20));
  if (answers_.size() < start + length) {
    return std::nullopt;
  }
  std::string body = answers_.substr(start, length);
  answers_.erase(0, start + length);
  return body;
}

PageLoad LoadServer(std::uint16_t port, const std::string& path, int connections,
                    std::chrono::milliseconds time) {
  std::vector<std::unique_ptr<PageConnection>> browsers;
  std::vector<pollfd> waits;
  for (int i = 0; i < connections; ++i) {
    browsers.push_back(std::make_unique<PageConnection>(port));
    browsers.back()->Ask(path);
    waits.push_back({.fd = browsers.back()->Handle(), .events = POLLIN, .revents = 0});
  }
  PageLoad load;
  std::size_t answers = 0;
  const auto answered = [&path](PageConnection& browser) {
    browser.Receive();
    const bool isWhole = browser.NextBody().has_value();
    if (isWhole) {
      browser.Ask(path);
    }
    return isWhole;
  };
  const auto start = Clock::now();
  while (Clock::now() - start < time && poll(waits.data(), waits.size(), 1000) > 0) {
    for (std::size_t at = 0; at < waits.size(); ++at) {
      if (waits[at].revents != 0) {
        try {
          answers += answered(*browsers[at]) ? 1 : 0;
        } catch (const std::exception&) {
          ++load.Failures;
          waits[at].fd = -1;
        }
      }
    }
  }
  const std::chrono::duration<double> taken = Clock::now() - start;
  load.RequestsPerSecond = static_cast<double>(answers) / taken.count();
  return load;
}
