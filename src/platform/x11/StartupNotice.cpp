#include "platform/x11/StartupNotice.h"

#include <xcb/xcb.h>

#include <algorithm>
#include <cstdlib>
#include <memory>
#include <string_view>

namespace {

struct Disconnect {
  void operator()(xcb_connection_t* connection) const { xcb_disconnect(connection); }
};
using Connection = std::unique_ptr<xcb_connection_t, Disconnect>;

struct Free {
  void operator()(void* reply) const { std::free(reply); }
};

xcb_atom_t AtomOf(xcb_connection_t* connection, std::string_view name) {
  const xcb_intern_atom_cookie_t question =
      xcb_intern_atom(connection, 0, static_cast<std::uint16_t>(name.size()), name.data());
  const std::unique_ptr<xcb_intern_atom_reply_t, Free> reply(
      xcb_intern_atom_reply(connection, question, nullptr));
  return reply ? reply->atom : xcb_atom_t{XCB_ATOM_NONE};
}

xcb_window_t RootOf(xcb_connection_t* connection, int screenNumber) {
  xcb_screen_iterator_t screens = xcb_setup_roots_iterator(xcb_get_setup(connection));
  for (; screenNumber > 0 && screens.rem > 1; --screenNumber) {
    xcb_screen_next(&screens);
  }
  return screens.data->root;
}

/// The message as desktops expect it: with its end, and the value in quotation marks.
std::string MessageFor(const std::string& id) {
  std::string message = "remove: ID=\"";
  for (const char letter : id) {
    if (letter == '"' || letter == '\\') {
      message += '\\';
    }
    message += letter;
  }
  message += '"';
  message += '\0';
  return message;
}

}  // namespace

void EndStartupNotice(const std::string& display, const std::string& id) {
  if (id.empty()) {
    return;
  }
  int screenNumber = 0;
  const Connection connection(xcb_connect(display.c_str(), &screenNumber));
  if (xcb_connection_has_error(connection.get()) != 0) {
    return;
  }
  const xcb_window_t root = RootOf(connection.get(), screenNumber);
  // The pieces of a message belong together by the window that they tell of.
  const xcb_window_t sender = xcb_generate_id(connection.get());
  xcb_create_window(connection.get(), XCB_COPY_FROM_PARENT, sender, root, 0, 0, 1, 1, 0,
                    XCB_WINDOW_CLASS_INPUT_ONLY, XCB_COPY_FROM_PARENT, 0, nullptr);
  xcb_client_message_event_t piece{};
  piece.response_type = XCB_CLIENT_MESSAGE;
  piece.format = 8;
  piece.window = sender;
  piece.type = AtomOf(connection.get(), "_NET_STARTUP_INFO_BEGIN");
  const xcb_atom_t next = AtomOf(connection.get(), "_NET_STARTUP_INFO");
  const std::string message = MessageFor(id);
  for (std::size_t at = 0; at < message.size(); at += sizeof piece.data.data8) {
    const std::string_view bytes = std::string_view(message).substr(at, sizeof piece.data.data8);
    std::fill(std::begin(piece.data.data8), std::end(piece.data.data8), std::uint8_t{0});
    std::copy(bytes.begin(), bytes.end(), std::begin(piece.data.data8));
    xcb_send_event(connection.get(), 0, root, XCB_EVENT_MASK_PROPERTY_CHANGE,
                   reinterpret_cast<const char*>(&piece));
    piece.type = next;
  }
  xcb_destroy_window(connection.get(), sender);
  // All of it has arrived when this is answered.
  AtomOf(connection.get(), "_NET_STARTUP_INFO");
}
