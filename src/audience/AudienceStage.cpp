#include "audience/AudienceStage.h"

#include <QBuffer>
#include <QImageReader>
#include <QPainter>

#include "audience/AudienceColours.h"
#include "audience/AudienceViews.h"
#include "core/text/Filled.h"
#include "ui/Text.h"

AudienceStage::AudienceStage(const AudienceState& state, const StringTable& strings)
    : state_(state), strings_(strings) {
  constexpr QSize usualScreen(1920, 1080);
  constexpr double usualInches = 40;
  SetArea(usualScreen, MillimetresPerPixel(usualInches, usualScreen.width(), usualScreen.height()));
  connect(&timer_, &QTimer::timeout, this, &AudienceStage::ShowNext);
}

void AudienceStage::SetSetup(const AudienceSetup& setup, const QImage& venuePicture) {
  setup_ = setup;
  venuePicture_ = venuePicture;
  place_.Metres = setup.Metres;
  Begin();
}

void AudienceStage::SetArea(const QSize& pixels, double millimetresPerPixel) {
  const AudiencePlace place{pixels.width(), pixels.height(), millimetresPerPixel, setup_.Metres};
  const bool isSame = place.Width == place_.Width && place.Height == place_.Height &&
                      place.MillimetresPerPixel == place_.MillimetresPerPixel;
  if (!isSame && !pixels.isEmpty()) {
    place_ = place;
    Begin();
  }
}

void AudienceStage::SetRunning(bool isRunning) {
  isRunning_ = isRunning;
  Begin();
}

void AudienceStage::Begin() {
  turn_ = 0;
  Arrange();
  Forget();
}

void AudienceStage::Arrange() {
  pages_.reset();
  timer_.stop();
  if (!isRunning_ || state_.View() != AudienceView::Results) {
    return;
  }
  pages_.emplace(state_.Results(), strings_, place_);
  if (Turns() > 1) {
    constexpr int milliseconds = 1000;
    timer_.start(setup_.Seconds * milliseconds);
  }
}

void AudienceStage::ShowNext() {
  turn_ = (turn_ + 1) % Turns();
  Forget();
}

void AudienceStage::Forget() {
  isPainted_ = false;
  emit PictureChanged();
}

int AudienceStage::Turns() const {
  return pages_ ? TurnCount(pages_->Count(), !state_.Address().empty()) : 1;
}

AudienceTurn AudienceStage::Turn() const {
  return pages_ ? TurnOf(turn_, pages_->Count(), !state_.Address().empty()) : AudienceTurn{state_.View(), 0};
}

const QImage& AudienceStage::Picture() {
  if (isPainted_) {
    return picture_;
  }
  const QSize size(place_.Width, place_.Height);
  if (picture_.size() != size) {
    picture_ = QImage(size, QImage::Format_RGB32);
  }
  const bool isBlank = state_.View() == AudienceView::Blank;
  picture_.fill(isBlank ? QColor(Qt::black) : AudienceColours::Page());
  QPainter painter(&picture_);
  painter.setRenderHint(QPainter::TextAntialiasing);
  PaintTurn(painter);
  isPainted_ = true;
  return picture_;
}

void AudienceStage::PaintTurn(QPainter& painter) const {
  const AudienceTurn turn = Turn();
  switch (turn.View) {
    case AudienceView::Results:
      if (pages_) {
        pages_->Paint(painter, turn.Page);
      }
      break;
    case AudienceView::Idle:
      AudienceViews::PaintVenue(painter, place_, QString::fromStdString(setup_.Venue), venuePicture_);
      break;
    case AudienceView::Incoming: {
      const std::string count =
          Filled(strings_.Text(OwnText::AudienceCount),
                 {std::to_string(state_.Received()), std::to_string(state_.Expected())});
      AudienceViews::PaintMessage(painter, place_, Text(strings_, OwnText::AudienceIncoming),
                                  state_.Expected() > 0 ? QString::fromStdString(count) : QString());
      break;
    }
    case AudienceView::Phone:
      AudienceViews::PaintCode(painter, place_, Text(strings_, OwnText::AudiencePhone),
                               QString::fromStdString(state_.Address()));
      break;
    case AudienceView::Blank:
      break;
  }
}

QImage ReadVenuePicture(const std::string& bytes) {
  constexpr QSize largest(3840, 2160);
  QByteArray data = QByteArray::fromRawData(bytes.data(), static_cast<qsizetype>(bytes.size()));
  QBuffer buffer(&data);
  QImageReader reader(&buffer);
  reader.setAutoTransform(true);
  if (const QSize size = reader.size(); size.width() > largest.width() || size.height() > largest.height()) {
    reader.setScaledSize(size.scaled(largest, Qt::KeepAspectRatio));
  }
  return reader.read();
}
