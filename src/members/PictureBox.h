#pragma once

#include <QImage>
#include <QWidget>
#include <string>

/// Shows a picture as large as fits, keeping its proportions, or a placeholder if there is none.
class PictureBox : public QWidget {
  Q_OBJECT

 public:
  explicit PictureBox(QWidget* parent);

  /// Shows the picture in `bytes`, in any format that Qt reads; shows none if they are not a picture. Bytes
  /// after the end of the picture are ignored.
  void Load(const std::string& bytes);
  void Clear();

  const QImage& Picture() const { return picture_; }

 protected:
  void paintEvent(QPaintEvent* event) override;

 private:
  QImage picture_;
};
