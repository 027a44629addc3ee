#include <QApplication>

#include "app/Program.h"

int main(int argc, char** argv) {
  QApplication application(argc, argv);
  return Program().Run();
}
