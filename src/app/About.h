#pragma once

#include <QDialog>

/// Name and version of the program.
class About : public QDialog {
  Q_OBJECT

 public:
  explicit About(QWidget* parent);
};
