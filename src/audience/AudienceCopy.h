#pragma once

#include <QPixmap>
#include <QWidget>

#include "audience/AudienceStage.h"

/// A small picture of what the audience sees, for the operator.
class AudienceCopy : public QWidget {
 public:
  /// `stage` must outlive this.
  AudienceCopy(AudienceStage& stage, QWidget* parent);

  QSize sizeHint() const override;

 protected:
  void paintEvent(QPaintEvent* event) override;

 private:
  AudienceStage& stage_;
  QPixmap small_;
  qint64 shown_ = 0;  ///< which picture that is
};
