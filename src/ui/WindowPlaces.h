#pragma once

#include <QList>
#include <QObject>
#include <QRect>
#include <map>
#include <optional>
#include <string>

#include "core/data/IniReader.h"

class QWidget;

/// Where a window was: its frame's corner with the size within the frame, in the toolkit's units.
struct WindowPlace {
  QRect Place;
  bool Maximised = false;
  bool operator==(const WindowPlace&) const = default;
};

/// "120,80,900,640" and, for a maximised window, ",maximised".
std::string TextOf(const WindowPlace& place);
/// Nothing where the text is no such place.
std::optional<WindowPlace> PlaceOf(const std::string& text);

/// The place on the one of today's screens that shows most of it, or on the first one, made smaller and
/// moved as far as it takes to lie within what panels leave of that screen. `areas` must not be empty.
QRect PlaceWithin(const QRect& place, const QList<QRect>& areas);

/// Remembers for each of the program's windows where the operator has put it. All but the main window get
/// their place before they are first shown, under their object's name; boxes and file dialogs are left alone.
/// A failure to write is silent.
class WindowPlaces : public QObject {
 public:
  /// `state` must outlive this. Needs a QApplication.
  explicit WindowPlaces(IniReader& state);

  /// Puts a window where it was. Returns false if it has no place yet.
  bool Restore(QWidget& window);

 protected:
  bool eventFilter(QObject* watched, QEvent* event) override;

 private:
  void Remember(const QWidget& window);

  IniReader& state_;
  struct Shown {
    WindowPlace Place;  ///< before the operator moved the window
    bool Settled;       ///< the desktop has put it there
  };
  std::map<const QObject*, Shown> shown_;  ///< the open windows
};
