#pragma once

#include <QTimer>
#include <QWidget>

/// Packets that fly from a gun to the desk while data come in; at rest an empty track.
class TransferAnimation : public QWidget {
  Q_OBJECT

 public:
  explicit TransferAnimation(QWidget* parent = nullptr);

  void Start();
  void Stop();

 protected:
  void paintEvent(QPaintEvent* event) override;

 private:
  QTimer step_;
  int phase_ = 0;  ///< 0 to PhaseCount - 1: how far the packets have flown to their successors' places
};
