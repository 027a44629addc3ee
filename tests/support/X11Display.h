#pragma once

#include <xcb/xcb.h>

#include <QProcess>
#include <QTest>
#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <string>

/// An X display of a test's own, on which the test hears what a desktop is told about starts.
class X11Display {
 public:
  X11Display() {
    server_.setProcessChannelMode(QProcess::SeparateChannels);
    server_.start(QStringLiteral("Xvfb"),
                  {QStringLiteral("-displayfd"), QStringLiteral("1"), QStringLiteral("-ac"),
                   QStringLiteral("-screen"), QStringLiteral("0"), QStringLiteral("1280x1024x24")});
    constexpr int patience = 60'000;  // milliseconds
    while (!server_.canReadLine() && server_.waitForReadyRead(patience)) {
    }
    name_ = ":" + server_.readLine().trimmed().toStdString();
    connection_ = xcb_connect(name_.c_str(), nullptr);
    if (Works()) {
      root_ = xcb_setup_roots_iterator(xcb_get_setup(connection_)).data->root;
      Listen();
    }
  }
  ~X11Display() {
    xcb_disconnect(connection_);
    server_.kill();
    server_.waitForFinished();
  }
  X11Display(const X11Display&) = delete;
  X11Display& operator=(const X11Display&) = delete;

  bool Works() const { return xcb_connection_has_error(connection_) == 0; }
  const std::string& Name() const { return name_; }

  /// The notices of starts until now, as sent.
  const std::string& StartupNotices() {
    Read();
    return notices_;
  }

 private:
  xcb_atom_t AtomOf(const std::string& name) const {
    const auto question =
        xcb_intern_atom(connection_, 0, static_cast<std::uint16_t>(name.size()), name.c_str());
    xcb_intern_atom_reply_t* reply = xcb_intern_atom_reply(connection_, question, nullptr);
    const xcb_atom_t atom = reply != nullptr ? reply->atom : xcb_atom_t{XCB_ATOM_NONE};
    std::free(reply);
    return atom;
  }

  void Listen() const {
    const std::uint32_t events = XCB_EVENT_MASK_PROPERTY_CHANGE;
    xcb_change_window_attributes(connection_, root_, XCB_CW_EVENT_MASK, &events);
    AtomOf("_NET_STARTUP_INFO");  // once that is answered, it has been heard
  }

  void Read() {
    const xcb_atom_t first = AtomOf("_NET_STARTUP_INFO_BEGIN");
    const xcb_atom_t next = AtomOf("_NET_STARTUP_INFO");
    while (xcb_generic_event_t* event = xcb_poll_for_event(connection_)) {
      const auto* message = reinterpret_cast<const xcb_client_message_event_t*>(event);
      if ((event->response_type & 0x7FU) == XCB_CLIENT_MESSAGE) {
        if (message->type == first || message->type == next) {
          const auto* bytes = reinterpret_cast<const char*>(message->data.data8);
          notices_.append(message->type == first ? "|" : "").append(bytes, strnlen(bytes, 20));
        }
      }
      std::free(event);
    }
  }

  QProcess server_;
  std::string name_;
  xcb_connection_t* connection_ = nullptr;
  xcb_window_t root_ = 0;
  std::string notices_;
};
