#pragma once

#include <QColor>
#include <QString>
#include <QWidget>
#include <vector>

/// Hits as horizontal bars, the largest first: as many as there is room for.
class HitBars : public QWidget {
  Q_OBJECT

 public:
  struct Bar {
    QString Name;
    int Amount;  ///< above 0
    QColor Colour;
  };

  explicit HitBars(QWidget* parent = nullptr);

  void SetBars(std::vector<Bar> bars);

 protected:
  void paintEvent(QPaintEvent* event) override;

 private:
  std::vector<Bar> bars_;
};
