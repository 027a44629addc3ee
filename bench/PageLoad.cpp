#include "bench/PageLoad.h"

#include <arpa/inet.h>
#include <netinet/in.h>
#include <poll.h>
#include <sys/socket.h>
#include <unistd.h>

#include <array>
#include <stdexcept>
#include <utility>
#include <vector>

namespace {

using Clock = std::chrono::steady_clock;

int Connected(std::uint16_t port) {
  const int handle = socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0);
  sockaddr_in address{};
  address.sin_family = AF_INET;
  address.sin_port = htons(port);
  address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
  if (connect(handle, reinterpret_cast<sockaddr*>(&address), sizeof address) != 0) {
    throw std::runtime_error("the server refuses a connection");
  }
  return handle;
}

/// One browser: an answer is over when its head and as many bytes as that says have come.
class Browser {
 public:
  Browser(std::uint16_t port, const std::string& request) : handle_(Connected(port)), request_(request) {
    Ask();
  }
  Browser(Browser&& other) noexcept
      : handle_(std::exchange(other.handle_, -1)),
        request_(other.request_),
        answer_(std::move(other.answer_)) {}
  Browser(const Browser&) = delete;
  Browser& operator=(const Browser&) = delete;
  ~Browser() {
    if (handle_ >= 0) {
      close(handle_);
    }
  }

  int Handle() const { return handle_; }

  /// Reads what came; true when the answer is whole, and then asks again. Throws when the connection ended or
  /// the answer is no page.
  bool Read() {
    std::array<char, 65536> bytes{};
    const ssize_t count = recv(handle_, bytes.data(), bytes.size(), 0);
    if (count <= 0) {
      throw std::runtime_error("a connection ended");
    }
    answer_.append(bytes.data(), static_cast<std::size_t>(count));
    const std::size_t head = answer_.find("\r\n\r\n");
    if (head == std::string::npos) {
      return false;
    }
    if (!answer_.starts_with("HTTP/1.1 200 ")) {
      throw std::runtime_error("an answer is no page");
    }
    const std::size_t length = std::stoul(answer_.substr(answer_.find("Content-Length: ") + 16));
    if (answer_.size() < head + 4 + length) {
      return false;
    }
    answer_.clear();
    Ask();
    return true;
  }

 private:
  void Ask() const { send(handle_, request_.data(), request_.size(), MSG_NOSIGNAL); }

  int handle_;
  const std::string& request_;
  std::string answer_;
};

}  // namespace

PageLoad LoadServer(std::uint16_t port, const std::string& path, int connections,
                    std::chrono::milliseconds time) {
  const std::string request =
      "GET " + path + " HTTP/1.1\r\nHost: 127.0.0.1:" + std::to_string(port) + "\r\n\r\n";
  std::vector<Browser> browsers;
  std::vector<pollfd> waits;
  for (int i = 0; i < connections; ++i) {
    browsers.emplace_back(port, request);
    waits.push_back({.fd = browsers.back().Handle(), .events = POLLIN, .revents = 0});
  }
  PageLoad load;
  std::size_t answers = 0;
  const auto start = Clock::now();
  while (Clock::now() - start < time && poll(waits.data(), waits.size(), 1000) > 0) {
    for (std::size_t at = 0; at < waits.size(); ++at) {
      if (waits[at].revents != 0) {
        try {
          answers += browsers[at].Read() ? 1 : 0;
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
