#include <gtest/gtest.h>

#include <QApplication>
#include <QTemporaryDir>

#include "ui/Look.h"

/// Main program of the window tests: a display in memory with the screens of Screens.json, and no settings of
/// this machine's user.
int main(int argc, char** argv) {
  testing::InitGoogleTest(&argc, argv);
  const QTemporaryDir settings;
  qputenv("XDG_CONFIG_HOME", settings.path().toLocal8Bit());
  const QByteArray platform = qgetenv("QT_QPA_PLATFORM");
  if (platform.isEmpty() || platform == "offscreen") {
    qputenv("QT_QPA_PLATFORM", "offscreen:configfile=" TESSARINE_TEST_SCREENS);
  }
  QApplication application(argc, argv);
  PrepareLook();
  return RUN_ALL_TESTS();
}
