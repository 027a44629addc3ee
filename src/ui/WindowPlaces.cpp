#include "ui/WindowPlaces.h"

#include <QApplication>
#include <QEvent>
#include <QFileDialog>
#include <QMainWindow>
#include <QMessageBox>
#include <QScreen>
#include <algorithm>

#include "ui/WorkArea.h"

namespace {

constexpr const char* Section = "windows";
constexpr const char* Maximised = "maximised";

WindowPlace PlaceOf(const QWidget& window) {
  const bool isMaximised = window.windowState().testFlag(Qt::WindowMaximized);
  const QRect inner = isMaximised ? window.normalGeometry() : window.geometry();
  const QPoint frame = window.geometry().topLeft() - window.frameGeometry().topLeft();
  return {QRect(isMaximised ? inner.topLeft() : inner.topLeft() - frame, inner.size()), isMaximised};
}

bool IsRemembered(const QObject& watched) {
  if (!watched.isWidgetType() || watched.objectName().isEmpty()) {
    return false;
  }
  const auto& widget = static_cast<const QWidget&>(watched);
  const bool isBox = qobject_cast<const QMessageBox*>(&widget) != nullptr ||
                     qobject_cast<const QFileDialog*>(&widget) != nullptr;
  // One without a frame has no place of the operator's choice.
  const bool hasFrame = !widget.windowFlags().testFlag(Qt::FramelessWindowHint);
  const Qt::WindowType type = widget.windowType();
  return !isBox && hasFrame && (type == Qt::Window || type == Qt::Dialog);
}

int OverlapOf(const QRect& first, const QRect& second) {
  const QRect common = first.intersected(second);
  return common.isEmpty() ? 0 : common.width() * common.height();
}

}  // namespace

std::string TextOf(const WindowPlace& place) {
  const QRect& rect = place.Place;
  std::string text;
  for (const int number : {rect.x(), rect.y(), rect.width(), rect.height()}) {
    text += (text.empty() ? "" : ",") + std::to_string(number);
  }
  return place.Maximised ? text + "," + Maximised : text;
}

std::optional<WindowPlace> PlaceOf(const std::string& text) {
  const QStringList parts = QString::fromStdString(text).split(QLatin1Char(','));
  constexpr int numbers = 4;
  constexpr int most = 100'000;  // larger than any desktop
  if (parts.size() < numbers || parts.size() > numbers + 1) {
    return std::nullopt;
  }
  int values[numbers];
  for (int i = 0; i < numbers; ++i) {
    bool isNumber = false;
    values[i] = parts[i].toInt(&isNumber);
    if (!isNumber || values[i] < -most || values[i] > most) {
      return std::nullopt;
    }
  }
  const QRect rect(values[0], values[1], values[2], values[3]);
  const bool isMaximised = parts.size() > numbers;
  if (rect.isEmpty() || (isMaximised && parts.last() != QLatin1String(Maximised))) {
    return std::nullopt;
  }
  return WindowPlace{rect, isMaximised};
}

QRect PlaceWithin(const QRect& place, const QList<QRect>& areas) {
  const QRect& area =
      *std::max_element(areas.begin(), areas.end(), [&](const QRect& left, const QRect& right) {
        return OverlapOf(place, left) < OverlapOf(place, right);
      });
  const QSize size = place.size().boundedTo(RoomIn(area.size()));
  const QSize frame = area.size() - RoomIn(area.size());
  const int right = area.x() + area.width() - frame.width() - size.width();
  const int bottom = area.y() + area.height() - frame.height() - size.height();
  return {QPoint(std::clamp(place.x(), area.x(), right), std::clamp(place.y(), area.y(), bottom)), size};
}

WindowPlaces::WindowPlaces(IniReader& state) : state_(state) {
  qApp->installEventFilter(this);
}

bool WindowPlaces::Restore(QWidget& window) {
  const std::optional<WindowPlace> place =
      PlaceOf(state_.ReadIni(Section, window.objectName().toStdString(), ""));
  if (!place) {
    return false;
  }
  QList<QRect> areas;
  for (const QScreen* screen : QGuiApplication::screens()) {
    areas.append(screen->availableGeometry());
  }
  const QRect within = PlaceWithin(place->Place, areas);
  window.resize(within.size());
  window.move(within.topLeft());
  window.setWindowState(window.windowState().setFlag(Qt::WindowMaximized, place->Maximised));
  return true;
}

bool WindowPlaces::eventFilter(QObject* watched, QEvent* event) {
  switch (event->type()) {
    case QEvent::Polish:
      if (IsRemembered(*watched) && qobject_cast<QMainWindow*>(watched) == nullptr) {
        Restore(*static_cast<QWidget*>(watched));
      }
      break;
    case QEvent::Show:
      if (!event->spontaneous() && IsRemembered(*watched)) {
        shown_[watched] = {PlaceOf(*static_cast<QWidget*>(watched)), false};
      }
      break;
    case QEvent::WindowActivate:
      // By now the desktop has put it somewhere, and the operator cannot have moved it yet.
      if (const auto shown = shown_.find(watched); shown != shown_.end() && !shown->second.Settled) {
        shown->second = {PlaceOf(*static_cast<QWidget*>(watched)), true};
      }
      break;
    case QEvent::Hide:
      if (!event->spontaneous() && IsRemembered(*watched)) {
        Remember(*static_cast<QWidget*>(watched));
      }
      break;
    default:
      break;
  }
  return QObject::eventFilter(watched, event);
}

void WindowPlaces::Remember(const QWidget& window) {
  const WindowPlace place = PlaceOf(window);
  const auto before = shown_.find(&window);
  if (before != shown_.end() && place != before->second.Place) {
    state_.WriteIni(Section, window.objectName().toStdString(), TextOf(place));
  }
  shown_.erase(&window);
}
