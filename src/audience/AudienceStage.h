#pragma once

#include <QImage>
#include <QObject>
#include <QTimer>
#include <optional>

#include "audience/AudiencePages.h"
#include "audience/AudienceSetup.h"
#include "audience/AudienceState.h"

/// The picture on the audience board: painted once for each turn, and shown by the board and by its small
/// copy. Between turns nothing is done.
class AudienceStage : public QObject {
  Q_OBJECT

 public:
  /// Both must outlive the stage.
  AudienceStage(const AudienceState& state, const StringTable& strings);

  /// What the operator has set, with the venue's picture, which may be null.
  void SetSetup(const AudienceSetup& setup, const QImage& venuePicture);

  /// The size of the board in pixels of its screen, and that of such a pixel.
  void SetArea(const QSize& pixels, double millimetresPerPixel);
  const AudiencePlace& Place() const { return place_; }

  /// Pages turn while something shows them.
  void SetRunning(bool isRunning);

  /// The state shows something else: begins again with the first turn.
  void Begin();

  /// The picture of this turn.
  const QImage& Picture();

  /// What stands there, and how many turns there are.
  AudienceTurn Turn() const;
  int Turns() const;

  /// True while turns follow each other by themselves.
  bool IsTurning() const { return timer_.isActive(); }
  void ShowNext();

 signals:
  void PictureChanged();

 private:
  void PaintTurn(QPainter& painter) const;
  /// Lays the pages out and lets them turn, if there are several.
  void Arrange();
  void Forget();

  const AudienceState& state_;
  const StringTable& strings_;
  AudienceSetup setup_;
  QImage venuePicture_;
  AudiencePlace place_;
  std::optional<AudiencePages> pages_;  ///< of the results, while they are shown
  int turn_ = 0;                        ///< counted from 0
  bool isRunning_ = false;
  bool isPainted_ = false;
  QImage picture_;
  QTimer timer_;
};

/// The picture in `bytes`, upright and at most as large as a screen; null if it is none.
QImage ReadVenuePicture(const std::string& bytes);
