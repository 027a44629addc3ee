#include "audience/AudienceBoard.h"

#include <QGuiApplication>
#include <QScreen>
#include <QWindow>
#include <utility>

#include "platform/RuntimeError.h"

namespace {

constexpr const char* StateSection = "audience";
constexpr const char* StateOn = "on";
constexpr const char* StateScreen = "screen";  ///< empty for an ordinary window

constexpr const char* Yes = "1";
constexpr const char* No = "0";

/// The screen of this name; null if there is none.
QScreen* ScreenOfName(const std::string& name) {
  for (QScreen* screen : QGuiApplication::screens()) {
    if (screen->name().toStdString() == name) {
      return screen;
    }
  }
  return nullptr;
}

QImage PictureAt(const std::string& path, const Files& disk) {
  constexpr std::uint64_t most = 64'000'000;
  try {
    return path.empty() || disk.FileLen(path) > most ? QImage() : ReadVenuePicture(disk.Read(path));
  } catch (const RuntimeError&) {
    return {};
  }
}

}  // namespace

AudienceBoard::AudienceBoard(const Parts& parts)
    : parts_(parts),
      setup_(ReadAudienceSetup(parts.Ini)),
      state_([this] { return Results(); },
             [this] {
               stage_.Begin();
               emit Changed();
             }),
      stage_(state_, parts.Strings),
      subscription_(parts.Session.Listen([this](SessionChange change) { Hear(change); })) {
  state_.SetFollows(setup_.Follows);
  connect(qApp, &QGuiApplication::screenAdded, this, [this](QScreen* screen) {
    Watch(*screen);
    HearScreens();
  });
  connect(qApp, &QGuiApplication::screenRemoved, this, [this](QScreen* screen) { HearScreens(screen); });
  for (QScreen* screen : QGuiApplication::screens()) {
    Watch(*screen);
  }
}

AudienceResults AudienceBoard::Results() const {
  if (!parts_.Session.Game().DataPresent) {
    return {};
  }
  AudienceResults results =
      ResultsOf(parts_.Session, [this](int index) { return parts_.Guests.NameOf(index); });
  ShowNames(results, parts_.NameShown);
  return results;
}

void AudienceBoard::ShowOtherNames() {
  state_.ChangeResults([this](AudienceResults& results) {
    LookUpNickNames(results, parts_.Session);
    ShowNames(results, parts_.NameShown);
  });
}

void AudienceBoard::Hear(SessionChange change) {
  if (change == SessionChange::Cleared) {
    state_.ForgetGame();
  } else if (change == SessionChange::Scores) {
    state_.TellScored();
  }
}

void AudienceBoard::Toggle() {
  if (isOn_) {
    TurnOff();
  } else {
    spot_ = {};
    TurnOn(true);
  }
}

void AudienceBoard::Reopen() {
  if (isOn_ || parts_.StateIni.ReadIni(StateSection, StateOn, No) != Yes) {
    return;
  }
  const std::string screen = parts_.StateIni.ReadIni(StateSection, StateScreen, {});
  spot_ = screen.empty() ? AudienceSpot{} : AudienceSpot{AudienceSpot::Kind::Nowhere, screen};
  TurnOn(false);
}

void AudienceBoard::End() {
  subscription_.End();
  Hide();
}

std::string AudienceBoard::AwaitedScreen() const {
  return isOn_ && spot_.Where == AudienceSpot::Kind::Nowhere ? spot_.Name : std::string();
}

void AudienceBoard::ShowResults() {
  if (!isOn_) {
    Toggle();
  }
  state_.ShowResults();
}

void AudienceBoard::SetGuests(GuestList::Names names) {
  parts_.Guests.SetNames(std::move(names));
  state_.TellScored();
}

void AudienceBoard::SetSetup(const AudienceSetup& setup) {
  WriteAudienceSetup(parts_.Ini, setup_, setup);
  const bool isElsewhere = setup.Screen != setup_.Screen;
  setup_ = setup;
  state_.SetFollows(setup_.Follows);
  if (!isOn_) {
    return;
  }
  ShowSetup();
  if (isElsewhere) {
    spot_ = {};
    PlaceWindow(true);
    Remember(true);
  }
}

void AudienceBoard::ShowSetup() {
  QImage picture = PictureAt(setup_.Picture, parts_.Disk);
  if (picture.isNull() && setup_.Venue.empty()) {  // a dark screen looks broken
    picture = QImage(QStringLiteral(":/pictures/tessarine-256.png"));
  }
  stage_.SetSetup(setup_, picture);
  if (window_) {
    window_->SetDiagonal(setup_.Inches);
  }
}

void AudienceBoard::TurnOn(bool takesFocus) {
  isOn_ = true;
  if (const QWindow* window = parts_.Operator.windowHandle()) {
    // Not before the window has arrived there.
    connect(window, &QWindow::screenChanged, this, &AudienceBoard::FollowOperator,
            static_cast<Qt::ConnectionType>(Qt::QueuedConnection | Qt::UniqueConnection));
  }
  state_.TurnOn();
  ShowSetup();
  stage_.SetRunning(true);
  PlaceWindow(takesFocus);
  Remember(true);
}

void AudienceBoard::TurnOff() {
  isOn_ = false;
  state_.TurnOff();
  stage_.SetRunning(false);
  Hide();
  Remember(false);
  emit Switched();
}

void AudienceBoard::Hide() {
  window_.reset();
  awake_.reset();
}

void AudienceBoard::PlaceWindow(bool takesFocus, const QScreen* gone) {
  const std::string held = spot_.Where == AudienceSpot::Kind::Window ? std::string() : spot_.Name;
  const AudienceSpot before = std::exchange(spot_, SpotOn(Screens(gone), setup_.Screen, held));
  if (spot_ != before || !window_) {
    Hide();
  }
  switch (spot_.Where) {
    case AudienceSpot::Kind::Screen:
      CoverScreen(spot_.Name);
      break;
    case AudienceSpot::Kind::Window:
      OpenWindow(takesFocus);
      break;
    case AudienceSpot::Kind::Nowhere:
      break;
  }
  if (window_ && !awake_) {
    awake_.emplace(parts_.Awake, parts_.Strings.Text(OwnText::AudienceTitle));
  }
  emit Switched();
}

void AudienceBoard::CoverScreen(const std::string& name) {
  QScreen& screen = *ScreenOfName(name);
  if (window_) {
    window_->Cover(screen);
    return;
  }
  MakeWindow(&screen);
  window_->show();
}

void AudienceBoard::OpenWindow(bool takesFocus) {
  if (window_) {
    return;
  }
  MakeWindow(nullptr);
  window_->setAttribute(Qt::WA_ShowWithoutActivating, !takesFocus);
  window_->setScreen(parts_.Operator.screen());
  window_->show();
}

void AudienceBoard::MakeWindow(QScreen* wholeScreen) {
  window_ = std::make_unique<AudienceWindow>(stage_, wholeScreen);
  window_->setWindowTitle(QString::fromStdString(parts_.Strings.Text(OwnText::AudienceTitle)));
  window_->SetDiagonal(setup_.Inches);
  // Not before the window has handled its own end.
  connect(window_.get(), &AudienceWindow::Closed, this, &AudienceBoard::TurnOff, Qt::QueuedConnection);
}

void AudienceBoard::Watch(QScreen& screen) {
  connect(&screen, &QScreen::geometryChanged, this, [this] { HearScreens(); });
}

void AudienceBoard::FollowOperator() {
  HearScreens();
}

void AudienceBoard::HearScreens(const QScreen* gone) {
  // A window of the operator's stays where it is.
  if (isOn_ && spot_.Where != AudienceSpot::Kind::Window) {
    PlaceWindow(false, gone);
  }
}

std::vector<AudienceScreen> AudienceBoard::Screens(const QScreen* gone) const {
  std::vector<AudienceScreen> screens;
  const QRect operators = parts_.Operator.screen()->geometry();
  for (const QScreen* screen : QGuiApplication::screens()) {
    if (screen != gone) {
      // Screens that show the same picture have the same place on the desktop.
      screens.push_back({screen->name().toStdString(), screen->geometry().intersects(operators)});
    }
  }
  return screens;
}

void AudienceBoard::Remember(bool isOn) {
  const std::string name = spot_.Where == AudienceSpot::Kind::Window ? std::string() : spot_.Name;
  const std::string on = isOn ? Yes : No;
  if (parts_.StateIni.ReadIni(StateSection, StateOn, No) != on ||
      parts_.StateIni.ReadIni(StateSection, StateScreen, {}) != name) {
    parts_.StateIni.WriteIni(StateSection, {{StateOn, on}, {StateScreen, name}});
  }
}
