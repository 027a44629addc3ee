#pragma once

#include <QWidget>

#include "sound/SoundLevels.h"

/// Paints the loudness of a sound along its time, with marks where it clips.
class LevelView : public QWidget {
  Q_OBJECT

 public:
  static constexpr std::size_t MostColumns = 400;

  explicit LevelView(QWidget* parent = nullptr);

  void Show(const SoundLevels& levels);

  QSize sizeHint() const override { return {200, 36}; }
  QSize minimumSizeHint() const override { return {100, 28}; }

 protected:
  void paintEvent(QPaintEvent* event) override;

 private:
  SoundLevels levels_;
};
