#pragma once

#include <QTimer>
#include <QWidget>

/// Packets that fly from a gun to the desk while data arrives; an empty track at rest.
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
  int phase_ = 0;  ///< 0 to PhaseCount - 1: how far each packet has flown towards the next one's place
};
