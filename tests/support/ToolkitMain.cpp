#include <gtest/gtest.h>

#include <QApplication>
#include <QTemporaryDir>

/// Main program of the tests that need Qt: without a display and without the settings of this machine's user.
int main(int argc, char** argv) {
  testing::InitGoogleTest(&argc, argv);
  const QTemporaryDir settings;
  qputenv("XDG_CONFIG_HOME", settings.path().toLocal8Bit());
  if (qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM")) {
    qputenv("QT_QPA_PLATFORM", "offscreen");
  }
  const QApplication application(argc, argv);
  return RUN_ALL_TESTS();
}
