#include <gtest/gtest.h>

#include <QApplication>

#include "app/Composition.h"

int main(int argc, char** argv) {
  if (qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM")) {
    qputenv("QT_QPA_PLATFORM", "offscreen");
  }
  testing::InitGoogleTest(&argc, argv);
  QApplication application(argc, argv);
  PrepareApplication();
  return RUN_ALL_TESTS();
}
