#pragma once

#include <xcb/xcb.h>

#include <QProcess>
#include <QTest>
#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <string>

/// An X display of a test's own, on which the test stands for the desktop: it says that it can activate
/// windows, never does, and notes what it is asked for.
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
      BeDesktop();
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
  /// True if a window has been shown.
  bool WindowShown() {
    Read();
    return windowShown_;
  }
  /// True if a window has asked to be activated.
  bool ActivationAsked() {
    Read();
    return activationAsked_;
  }
  /// True if a window has asked for attention.
  bool AttentionAsked() {
    Read();
    return attentionAsked_;
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

  void BeDesktop() const {
    const std::uint32_t events = XCB_EVENT_MASK_PROPERTY_CHANGE | XCB_EVENT_MASK_SUBSTRUCTURE_NOTIFY;
    xcb_change_window_attributes(connection_, root_, XCB_CW_EVENT_MASK, &events);
    const xcb_atom_t supported[] = {AtomOf("_NET_ACTIVE_WINDOW"), AtomOf("_NET_WM_STATE"),
                                    AtomOf("_NET_WM_STATE_DEMANDS_ATTENTION")};
    xcb_change_property(connection_, XCB_PROP_MODE_REPLACE, root_, AtomOf("_NET_SUPPORTED"), XCB_ATOM_ATOM,
                        32, 3, static_cast<const xcb_atom_t*>(supported));
    AtomOf("_NET_SUPPORTED");  // until then all has arrived
  }

  void Read() {
    const xcb_atom_t active = AtomOf("_NET_ACTIVE_WINDOW");
    const xcb_atom_t state = AtomOf("_NET_WM_STATE");
    const xcb_atom_t attention = AtomOf("_NET_WM_STATE_DEMANDS_ATTENTION");
    const xcb_atom_t first = AtomOf("_NET_STARTUP_INFO_BEGIN");
    const xcb_atom_t next = AtomOf("_NET_STARTUP_INFO");
    while (xcb_generic_event_t* event = xcb_poll_for_event(connection_)) {
      const auto* message = reinterpret_cast<const xcb_client_message_event_t*>(event);
      windowShown_ |= (event->response_type & 0x7FU) == XCB_MAP_NOTIFY;
      if ((event->response_type & 0x7FU) == XCB_CLIENT_MESSAGE) {
        activationAsked_ |= message->type == active;
        attentionAsked_ |= message->type == state && message->data.data32[0] == 1 &&
                           (message->data.data32[1] == attention || message->data.data32[2] == attention);
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
  bool windowShown_ = false;
  bool activationAsked_ = false;
  bool attentionAsked_ = false;
};
