#pragma once

#include <QImage>
#include <QWidget>
#include <string>

/// Shows a picture as large as it fits, with its own proportions; an empty frame without one.
class PictureBox : public QWidget {
  Q_OBJECT

 public:
  explicit PictureBox(QWidget* parent);

  /// Shows the picture in `bytes`, of any kind that the toolkit reads; none when they hold none. What follows
  /// the end of the picture is ignored.
  void Load(const std::string& bytes);
  void Clear();

  const QImage& Picture() const { return picture_; }

 protected:
  void paintEvent(QPaintEvent* event) override;

 private:
  QImage picture_;
};
