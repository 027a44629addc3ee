#include "app/About.h"

#include "app/Version.h"
#include "ui_About.h"

About::About(QWidget* parent) : QDialog(parent) {
  Ui::About ui;
  ui.setupUi(this);
  ui.VersionInfo->setText(QString::fromUtf8(VersionText));
}
