#pragma once

#include <arpa/inet.h>
#include <netinet/in.h>
#include <poll.h>
#include <sys/socket.h>
#include <sys/wait.h>
#include <unistd.h>

#include <array>
#include <csignal>
#include <cstdint>
#include <fstream>
#include <iterator>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "platform/linux/ChildProcess.h"
#include "web/PageStream.h"

/// Limit of every wait, in milliseconds: far longer than anything takes.
inline constexpr int WireLimit = 20'000;

/// A connection to a port of this computer.
class RawClient {
 public:
  /// `from` is the own address, one of this computer.
  explicit RawClient(std::uint16_t port, const char* from = "127.0.0.1")
      : socket_(::socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0)) {
    sockaddr_in own{};
    own.sin_family = AF_INET;
    inet_pton(AF_INET, from, &own.sin_addr);
    sockaddr_in address{};
    address.sin_family = AF_INET;
    address.sin_port = htons(port);
    address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    connected_ = bind(socket_.Number(), reinterpret_cast<sockaddr*>(&own), sizeof own) == 0 &&
                 connect(socket_.Number(), reinterpret_cast<sockaddr*>(&address), sizeof address) == 0;
  }

  bool Connected() const { return connected_; }

  /// False once the other side has closed.
  bool Send(const std::string& bytes) const {
    return send(socket_.Number(), bytes.data(), bytes.size(), MSG_NOSIGNAL) ==
           static_cast<ssize_t>(bytes.size());
  }

  /// Reads until the other side closes; nothing more after the limit.
  std::string ReadAll() {
    while (ReadSome()) {
    }
    return std::exchange(read_, {});
  }

  /// Reads a whole answer with its body, on a connection that stays open.
  std::string ReadAnswer(bool hasBody = true) {
    std::size_t end = std::string::npos;
    while ((end = EndOfAnswer(hasBody)) == std::string::npos) {
      if (!ReadSome()) {
        return std::exchange(read_, {});
      }
    }
    std::string answer = read_.substr(0, end);
    read_.erase(0, end);
    return answer;
  }

  /// Reads what the system holds on its way, as long as nothing more is sent; how many bytes it was.
  std::size_t CountWaiting() {
    std::size_t sum = 0;
    std::array<char, 65536> bytes{};
    pollfd wait{.fd = socket_.Number(), .events = POLLIN, .revents = 0};
    while (poll(&wait, 1, 200) == 1) {
      const ssize_t count = recv(socket_.Number(), bytes.data(), bytes.size(), 0);
      if (count <= 0) {
        break;
      }
      sum += static_cast<std::size_t>(count);
    }
    return sum;
  }

  /// True when the other side has closed, which is waited for.
  bool IsClosed() {
    while (ReadSome()) {
    }
    return closed_;
  }

 private:
  bool ReadSome() {
    pollfd wait{.fd = socket_.Number(), .events = POLLIN, .revents = 0};
    if (poll(&wait, 1, WireLimit) != 1) {
      return false;
    }
    std::array<char, 65536> bytes{};
    const ssize_t count = recv(socket_.Number(), bytes.data(), bytes.size(), 0);
    closed_ = count <= 0;
    if (count > 0) {
      read_.append(bytes.data(), static_cast<std::size_t>(count));
    }
    return count > 0;
  }

  std::size_t EndOfAnswer(bool hasBody) const {
    const std::size_t head = read_.find("\r\n\r\n");
    if (head == std::string::npos) {
      return head;
    }
    const std::size_t length = read_.find("Content-Length: ");
    const std::size_t body = hasBody && length < head ? std::stoul(read_.substr(length + 16)) : 0;
    return read_.size() >= head + 4 + body ? head + 4 + body : std::string::npos;
  }

  Descriptor socket_;
  bool connected_ = false;
  bool closed_ = false;
  std::string read_;
};

/// The program that serves pages, started as Tessarine starts it.
class ResultsProgram {
 public:
  /// `handles` is the most that the system lets it have; 0 for as many as this program.
  explicit ResultsProgram(std::uint16_t port = 18'100, const std::string& address = "127.0.0.1",
                          int handles = 0) {
    Pipe orders;
    Pipe reports;
    StandardStreams streams;
    streams.Input = orders.ReadEnd.Number();
    streams.Output = reports.WriteEnd.Number();
    std::vector<std::string> words{TESSARINE_RESULTS_PROGRAM, address, std::to_string(port)};
    if (handles > 0) {
      const std::string limit = "ulimit -n " + std::to_string(handles) + R"(; exec "$0" "$@")";
      words.insert(words.begin(), {"/bin/sh", "-c", limit});
    }
    process_ = StartProcess(words, streams, ProcessKind::Child);
    reports.WriteEnd.Close();  // or the end of the program would not end the stream
    input_ = std::move(orders.WriteEnd);
    output_ = std::move(reports.ReadEnd);
    if (const auto report = NextReport(); report && report->Kind == ReportKind::Port) {
      Port = static_cast<std::uint16_t>(report->Number);
    }
  }

  ~ResultsProgram() {
    if (process_ > 0) {
      kill(process_, SIGKILL);
      WaitForEnd();
    }
  }
  ResultsProgram(const ResultsProgram&) = delete;
  ResultsProgram& operator=(const ResultsProgram&) = delete;

  /// 0 if it reported none.
  std::uint16_t Port = 0;

  void Write(const std::string& bytes) const {
    std::size_t at = 0;
    while (at < bytes.size()) {
      const ssize_t count = write(input_.Number(), bytes.data() + at, bytes.size() - at);
      if (count <= 0) {
        return;
      }
      at += static_cast<std::size_t>(count);
    }
  }

  void Put(const std::string& path, const std::string& body) const {
    Write(EncodeFrame({.Order = PageOrder::Put, .Path = path, .Body = body}));
  }

  void Show() const { Write(EncodeFrame({})); }

  /// Waits until the orders so far have taken effect.
  void Settle() {
    const std::string path = "/settled" + std::to_string(++settled_);
    Put(path, "x");
    Show();
    for (int tries = 0; tries < 1000 && !Get(path).starts_with("HTTP/1.1 200"); ++tries) {
    }
  }

  std::optional<PageReport> NextReport() {
    for (;;) {
      if (const auto report = reader_.Next()) {
        return report;
      }
      pollfd wait{.fd = output_.Number(), .events = POLLIN, .revents = 0};
      std::array<char, 64> bytes{};
      const ssize_t count =
          poll(&wait, 1, WireLimit) == 1 ? read(output_.Number(), bytes.data(), bytes.size()) : 0;
      if (count <= 0) {
        return std::nullopt;
      }
      reader_.Add({bytes.data(), static_cast<std::size_t>(count)});
    }
  }

  std::string Host() const { return "Host: 127.0.0.1:" + std::to_string(Port) + "\r\n"; }

  /// The answer to a request, which ends the connection.
  std::string Ask(const std::string& firstLine, const std::string& headers) const {
    RawClient client(Port);
    client.Send(firstLine + "\r\n" + headers + "Connection: close\r\n\r\n");
    return client.ReadAll();
  }
  std::string Get(const std::string& path) const { return Ask("GET " + path + " HTTP/1.1", Host()); }

  pid_t Process() const { return process_; }
  void CloseInput() { input_.Close(); }

  /// Waits for its end; the exit status, or -1 if it did not exit by itself.
  int WaitForEnd() {
    int status = 0;
    waitpid(std::exchange(process_, 0), &status, 0);
    return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
  }

  /// A file of the system about the process.
  std::string About(const std::string& file) const {
    std::ifstream stream("/proc/" + std::to_string(process_) + "/" + file);
    return {std::istreambuf_iterator<char>(stream), {}};
  }

 private:
  pid_t process_ = 0;
  Descriptor input_;
  Descriptor output_;
  PageReportReader reader_;
  int settled_ = 0;
};
