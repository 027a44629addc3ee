#include "audience/AudienceSettings.h"

#include <QFileInfo>
#include <QGuiApplication>
#include <QScreen>
#include <algorithm>
#include <cmath>

#include "audience/AudienceLayout.h"
#include "audience/AudienceWindow.h"
#include "core/text/Filled.h"
#include "platform/RuntimeError.h"
#include "ui/Captions.h"
#include "ui/Text.h"
#include "ui_AudienceSettings.h"

namespace {

constexpr const char* PictureFilter = "*.png *.jpg *.jpeg *.bmp *.gif";

/// A full evening on a screen, from which the operator can judge.
AudienceLayout UsualLayout(const AudienceSetup& setup, const QScreen& screen) {
  const QSize pixels = ScreenPixels(screen);
  const double inches = setup.Inches > 0 ? setup.Inches : DiagonalOf(screen);
  const AudiencePlace place{pixels.width(), pixels.height(),
                            MillimetresPerPixel(inches, pixels.width(), pixels.height()), setup.Metres};
  return LayOut(place, {.Players = 40, .Teams = 3, .Place = 2, .Gun = 3, .Name = 8, .Points = 4, .Total = 5});
}

}  // namespace

AudienceSettings::AudienceSettings(const AudienceSetup& setup, const Parts& parts, QWidget* parent)
    : QDialog(parent),
      ui_(std::make_unique<Ui::AudienceSettings>()),
      parts_(parts),
      commands_(*this, parts.Boxes) {
  ui_->setupUi(this);
  SetUpTexts();
  ListScreens(setup.Screen);
  Fill(setup);
  const auto follow = [this] { ShowConsequence(); };
  connect(ui_->AudienceScreen, &QComboBox::currentIndexChanged, this, follow);
  connect(ui_->Distance, &QDoubleSpinBox::valueChanged, this, follow);
  connect(ui_->Diagonal, &QDoubleSpinBox::valueChanged, this, follow);
  commands_.Connect(*ui_->ChoosePicture, [this] { ChoosePicture(); });
  commands_.Connect(*ui_->NoPicture, [this] { ShowPicture({}); });
  connect(ui_->SaveExit, &QPushButton::clicked, this, &QDialog::accept);
  connect(ui_->Cancel, &QPushButton::clicked, this, &QDialog::reject);
  ShowConsequence();
}

AudienceSettings::~AudienceSettings() = default;

void AudienceSettings::SetUpTexts() {
  const auto number = [](OwnText text) { return static_cast<int>(text); };
  SetCaptions(parts_.Strings, {{this, number(OwnText::AudienceSettingsTitle)},
                               {ui_->ScreenLabel, number(OwnText::AudienceScreen)},
                               {ui_->DistanceLabel, number(OwnText::AudienceDistance)},
                               {ui_->DiagonalLabel, number(OwnText::AudienceDiagonal)},
                               {ui_->SecondsLabel, number(OwnText::AudienceSeconds)},
                               {ui_->VenueLabel, number(OwnText::AudienceVenue)},
                               {ui_->PictureLabel, number(OwnText::AudiencePicture)},
                               {ui_->ChoosePicture, number(OwnText::AudienceChoosePicture)},
                               {ui_->NoPicture, number(OwnText::AudienceNoPicture)},
                               {ui_->Follow, number(OwnText::AudienceFollow)},
                               {ui_->SaveExit, 162},
                               {ui_->Cancel, 141}});
  ui_->Distance->setSuffix(Text(parts_.Strings, OwnText::AudienceMetres));
  ui_->Diagonal->setSuffix(Text(parts_.Strings, OwnText::AudienceInches));
  ui_->Diagonal->setSpecialValueText(Text(parts_.Strings, OwnText::AudienceOwnSize));
}

void AudienceSettings::ListScreens(const std::string& chosen) {
  screens_ = {std::string()};
  ui_->AudienceScreen->addItem(Text(parts_.Strings, OwnText::AudienceAnyScreen));
  for (const QScreen* screen : QGuiApplication::screens()) {
    const QSize pixels = ScreenPixels(*screen);
    screens_.push_back(screen->name().toStdString());
    ui_->AudienceScreen->addItem(
        QStringLiteral("%1 (%2 x %3)").arg(screen->name()).arg(pixels.width()).arg(pixels.height()));
  }
  if (std::ranges::find(screens_, chosen) == screens_.end()) {  // it is not plugged in
    screens_.push_back(chosen);
    ui_->AudienceScreen->addItem(QString::fromStdString(chosen));
  }
  const auto found = std::ranges::find(screens_, chosen);
  ui_->AudienceScreen->setCurrentIndex(static_cast<int>(found - screens_.begin()));
}

void AudienceSettings::Fill(const AudienceSetup& setup) {
  using namespace AudienceLimits;
  // The least value stands for the screen's own size.
  ui_->Diagonal->setRange(LeastInches - 1, MostInches);
  ui_->Distance->setRange(LeastMetres, MostMetres);
  ui_->SecondsAPage->setRange(LeastSeconds, MostSeconds);
  ui_->Diagonal->setValue(setup.Inches);
  ui_->Distance->setValue(setup.Metres);
  ui_->SecondsAPage->setValue(setup.Seconds);
  constexpr int longest = 60;
  ui_->VenueName->setMaxLength(longest);
  ui_->VenueName->setText(QString::fromStdString(setup.Venue));
  ui_->Follow->setChecked(setup.Follows);
  ShowPicture(setup.Picture);
}

AudienceSetup AudienceSettings::Setup() const {
  AudienceSetup setup;
  setup.Screen = screens_.at(static_cast<std::size_t>(ui_->AudienceScreen->currentIndex()));
  setup.Metres = ui_->Distance->value();
  const double inches = ui_->Diagonal->value();
  setup.Inches = inches < AudienceLimits::LeastInches ? 0 : inches;
  setup.Seconds = ui_->SecondsAPage->value();
  setup.Venue = ui_->VenueName->text().trimmed().toStdString();
  setup.Picture = picture_;
  setup.Follows = ui_->Follow->isChecked();
  return setup;
}

void AudienceSettings::ChoosePicture() {
  const std::string title = parts_.Strings.Text(OwnText::AudienceChoosePicture);
  const auto path =
      parts_.Dialogs.ShowOpen({.Filter = title + "|" + PictureFilter, .Name = picture_, .Title = title});
  if (!path) {
    return;
  }
  if (ReadVenuePicture(parts_.Disk.Read(*path)).isNull()) {
    parts_.Boxes.Show(Filled(parts_.Strings.Text(OwnText::AudienceBadPicture), {*path}), DefaultBoxTitle,
                      BoxIcon::Exclamation);
    return;
  }
  ShowPicture(*path);
}

void AudienceSettings::ShowPicture(const std::string& path) {
  picture_ = path;
  const QString whole = QString::fromStdString(path);
  ui_->PictureName->setText(QFileInfo(whole).fileName());
  ui_->PictureName->setCursorPosition(0);
  ui_->PictureName->setToolTip(whole);
  ui_->NoPicture->setEnabled(!path.empty());
}

void AudienceSettings::ShowConsequence() {
  const AudienceSetup setup = Setup();
  const QList<QScreen*> screens = QGuiApplication::screens();
  const QScreen* screen = screens.value(1, screens.first());
  for (const QScreen* each : screens) {
    if (each->name().toStdString() == setup.Screen) {
      screen = each;
    }
  }
  const AudienceLayout layout = UsualLayout(setup, *screen);
  const bool isTooSmall = !layout.Names || layout.Minutes < LegibleMinutes - 0.01;
  const std::string millimetres =
      std::to_string(std::lround(CapitalMillimetres(setup.Metres, layout.Minutes)));
  const std::string rows = std::to_string(layout.Columns * layout.Rows);
  const OwnText text = isTooSmall ? OwnText::AudienceTooSmall : OwnText::AudienceLetters;
  std::string told = Filled(parts_.Strings.Text(text), {millimetres, rows});
  if (layout.Winners < MostLargeWinners) {
    const OwnText winners = layout.Winners > 0 ? OwnText::AudienceFewWinners : OwnText::AudienceNoWinners;
    told.append("\n").append(Filled(parts_.Strings.Text(winners), {std::to_string(layout.Winners)}));
  }
  ui_->Consequence->setText(QString::fromStdString(told));
  MakeRoom();
}

void AudienceSettings::showEvent(QShowEvent* event) {
  QDialog::showEvent(event);
  MakeRoom();
}

void AudienceSettings::MakeRoom() {
  layout()->activate();
  if (const int needed = layout()->totalHeightForWidth(width()); isVisible() && height() < needed) {
    resize(width(), needed);
  }
}
