#include "web/server/PageHost.h"

#include <microhttpd.h>
#include <strings.h>
#include <sys/socket.h>

#include <algorithm>
#include <cstdint>
#include <cstring>
#include <memory>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "web/server/Answers.h"
#include "web/server/OpenConnections.h"

namespace {

/// What is read of a request's head.
struct RequestHead {
  std::string_view Host;
  int Hosts = 0;
  std::string_view Known;
  bool HasBody = false;
  bool IsCut = false;    ///< a zero byte in its first line hides the rest of the path
  bool IsTrial = false;  ///< asks for no page: a trial request of the program's own, or what does as that
};

MHD_Result ReadHead(void* cls, MHD_ValueKind /*kind*/, const char* key, const char* value) {
  auto& head = *static_cast<RequestHead*>(cls);
  if (value != nullptr && strcasecmp(key, MHD_HTTP_HEADER_HOST) == 0) {
    head.Host = value;
    ++head.Hosts;
  } else if (value != nullptr && strcasecmp(key, MHD_HTTP_HEADER_IF_NONE_MATCH) == 0) {
    head.Known = value;
  } else if (strcasecmp(key, MHD_HTTP_HEADER_CONTENT_LENGTH) == 0 ||
             strcasecmp(key, MHD_HTTP_HEADER_TRANSFER_ENCODING) == 0) {
    head.HasBody = true;
  }
  return MHD_YES;
}

MHD_Result AcceptPrivate(void* /*cls*/, const sockaddr* address, socklen_t /*length*/) {
  return IsPrivate(*address) ? MHD_YES : MHD_NO;
}

/// Paths are compared as they come: none of ours needs an escape.
std::size_t KeepEscapes(void* /*cls*/, MHD_Connection* /*connection*/, char* text) {
  return std::strlen(text);
}

/// True if a path goes on behind its first zero byte, which is where it ends for the library. `length` is
/// that of its text with the query; the version stands in the same line, behind the real end and a blank.
bool IsPathCut(const char* path, std::size_t length, const char* version, std::size_t longestHead) {
  const std::uintptr_t apart =
      reinterpret_cast<std::uintptr_t>(version) - reinterpret_cast<std::uintptr_t>(path);
  return apart < longestHead && apart != length + 1;
}

bool SameHost(std::string_view host, const std::string& ours) {
  return host.size() == ours.size() && strncasecmp(host.data(), ours.data(), ours.size()) == 0;
}

/// The path of a request, and whether its first line names a host that is ours or none.
struct RequestTarget {
  std::string_view Path;
  bool IsOurs = true;
};

RequestTarget TargetOf(std::string_view url, const std::vector<std::string>& hosts) {
  constexpr std::string_view scheme = "http://";
  if (strncasecmp(url.data(), scheme.data(), scheme.size()) != 0) {
    return {.Path = url};
  }
  url.remove_prefix(scheme.size());
  const std::size_t end = std::min(url.find('/'), url.size());
  const std::string_view host = url.substr(0, end);
  return {
      .Path = end < url.size() ? url.substr(end) : "/",
      .IsOurs = std::ranges::any_of(hosts, [host](const std::string& ours) { return SameHost(host, ours); })};
}

}  // namespace

class PageHost::Daemon {
 public:
  Daemon(const ListenSocket& socket, const ServedPages& pages, Visitors& visitors, const Limits& limits)
      : answers_(pages),
        visitors_(visitors),
        hosts_(HostsOf(socket.Served)),
        longestHead_(limits.Head),
        connections_({.InAll = limits.Connections - Spare,
                      .OfAddress = limits.OfAddress,
                      .First = limits.First,
                      .Request = limits.Request}) {
    daemon_ = MHD_start_daemon(
        MHD_USE_EPOLL | MHD_USE_TURBO, 0, &AcceptPrivate, nullptr, &Daemon::Asked, this,
        MHD_OPTION_LISTEN_SOCKET, socket.Handle, MHD_OPTION_CONNECTION_LIMIT, limits.Connections,
        MHD_OPTION_PER_IP_CONNECTION_LIMIT, limits.OfAddress + Spare, MHD_OPTION_CONNECTION_MEMORY_LIMIT,
        limits.Head, MHD_OPTION_CONNECTION_TIMEOUT, static_cast<unsigned>(limits.Request.count()),
        MHD_OPTION_SIGPIPE_HANDLED_BY_APP, 1, MHD_OPTION_UNESCAPE_CALLBACK, &KeepEscapes, nullptr,
        MHD_OPTION_NOTIFY_CONNECTION, &Daemon::Connected, this, MHD_OPTION_URI_LOG_CALLBACK, &Daemon::Asks,
        nullptr, MHD_OPTION_NOTIFY_COMPLETED, &Daemon::Answered, this, MHD_OPTION_END);
  }
  ~Daemon() {
    if (daemon_ != nullptr) {
      MHD_stop_daemon(daemon_);
    }
  }
  Daemon(const Daemon&) = delete;
  Daemon& operator=(const Daemon&) = delete;

  MHD_Daemon* Library() const { return daemon_; }
  std::size_t Open() const { return connections_.Count(); }
  void Forget() { answers_.Forget(); }

  void EndSlowOnes(Visitors::Time now) { connections_.EndSlowOnes(now); }

 private:
  using Place = OpenConnections::Place;

  static MHD_Result Asked(void* cls, MHD_Connection* connection, const char* url, const char* method,
                          const char* version, const char* /*upload*/, std::size_t* /*uploadSize*/,
                          void** request) {
    RequestHead head;
    auto& daemon = *static_cast<Daemon*>(cls);
    OpenConnections::Connection* const asker = AskerOf(connection);
    if (asker != nullptr) {
      asker->HasAsked = true;
      head.IsCut = IsPathCut(url, asker->PathLength, version, daemon.longestHead_);
    }
    MHD_get_connection_values(connection, MHD_HEADER_KIND, &ReadHead, &head);
    const std::string_view asked = method;
    head.IsTrial = asked == MHD_HTTP_METHOD_HEAD;
    const bool reads = asked == MHD_HTTP_METHOD_GET || head.IsTrial;
    // An answer to the first call, when only the head was read, ends the connection: right for those who want
    // to send something, but phones shall keep theirs.
    if (reads && !head.HasBody && *request == nullptr) {
      *request = connection;
      return MHD_YES;
    }
    const Answers::Choice choice = daemon.Choose(connection, url, reads, head);
    return MHD_queue_response(connection, choice.Status, choice.What);
  }

  Answers::Choice Choose(MHD_Connection* connection, std::string_view url, bool reads,
                         const RequestHead& head) {
    const MHD_ConnectionInfo* info = MHD_get_connection_info(connection, MHD_CONNECTION_INFO_CLIENT_ADDRESS);
    if (!head.IsTrial) {
      visitors_.Note(AddressKey(*info->client_addr), std::chrono::steady_clock::now());
    }
    const bool ours = head.Hosts == 1 && std::ranges::any_of(hosts_, [&head](const std::string& host) {
                        return SameHost(head.Host, host);
                      });
    const RequestTarget target = TargetOf(url, hosts_);
    if (!ours || !target.IsOurs) {
      return answers_.ForOtherHost();
    }
    const std::string_view path = head.IsCut ? std::string_view() : target.Path;
    return reads ? answers_.For(path, head.Known) : answers_.ForOtherMethod();
  }

  static void Connected(void* cls, MHD_Connection* connection, void** context,
                        MHD_ConnectionNotificationCode what) {
    auto& daemon = *static_cast<Daemon*>(cls);
    if (what == MHD_CONNECTION_NOTIFY_STARTED) {
      *context = new Place(daemon.Add(connection));
    } else {
      const std::unique_ptr<Place> place(static_cast<Place*>(*context));
      daemon.connections_.Remove(*place);
      *context = nullptr;
    }
  }

  Place Add(MHD_Connection* connection) {
    const int handle = MHD_get_connection_info(connection, MHD_CONNECTION_INFO_CONNECTION_FD)->connect_fd;
    const std::string address =
        AddressKey(*MHD_get_connection_info(connection, MHD_CONNECTION_INFO_CLIENT_ADDRESS)->client_addr);
    return connections_.Add(handle, address, std::chrono::steady_clock::now());
  }

  static void Answered(void* /*cls*/, MHD_Connection* connection, void** /*request*/,
                       MHD_RequestTerminationCode /*how*/) {
    if (OpenConnections::Connection* const asker = AskerOf(connection)) {
      asker->Since = std::chrono::steady_clock::now();
    }
  }

  /// The first line of a request is there.
  static void* Asks(void* /*cls*/, const char* path, MHD_Connection* connection) {
    if (OpenConnections::Connection* const asker = AskerOf(connection)) {
      asker->PathLength = std::strlen(path);
    }
    return nullptr;
  }

  static OpenConnections::Connection* AskerOf(MHD_Connection* connection) {
    const MHD_ConnectionInfo* info = MHD_get_connection_info(connection, MHD_CONNECTION_INFO_SOCKET_CONTEXT);
    return info->socket_context != nullptr ? &**static_cast<Place*>(info->socket_context) : nullptr;
  }

  Answers answers_;
  Visitors& visitors_;
  std::vector<std::string> hosts_;
  std::size_t longestHead_;
  OpenConnections connections_;
  MHD_Daemon* daemon_ = nullptr;
};

PageHost::PageHost(const ListenSocket& socket, const ServedPages& pages, Visitors& visitors,
                   const Limits& limits)
    : daemon_(std::make_unique<Daemon>(socket, pages, visitors, limits)) {}

PageHost::~PageHost() = default;

bool PageHost::Serving() const {
  return daemon_->Library() != nullptr;
}

int PageHost::Handle() const {
  return MHD_get_daemon_info(daemon_->Library(), MHD_DAEMON_INFO_EPOLL_FD)->epoll_fd;
}

void PageHost::Run() {
  MHD_run(daemon_->Library());
}

std::chrono::milliseconds PageHost::Due() const {
  MHD_UNSIGNED_LONG_LONG pause = 0;
  return std::chrono::milliseconds(
      MHD_get_timeout(daemon_->Library(), &pause) == MHD_YES ? static_cast<std::int64_t>(pause) : -1);
}

void PageHost::EndSlowOnes(Visitors::Time now) {
  daemon_->EndSlowOnes(now);
}

std::size_t PageHost::Connections() const {
  return daemon_->Open();
}

void PageHost::Forget() {
  daemon_->Forget();
}
