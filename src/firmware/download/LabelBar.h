#pragma once

#include <QLabel>

/// A progress bar of two labels: this one is its background, and the first label in it its foreground.
class LabelBar : public QLabel {
  Q_OBJECT

 public:
  explicit LabelBar(QWidget* parent = nullptr);

  /// Fills a share of the width, 0 to 1.
  void SetShare(double share);

 protected:
  void resizeEvent(QResizeEvent* event) override;

 private:
  void PlaceForeground();

  double share_ = 0;
};
