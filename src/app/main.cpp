#include <QApplication>

#include "app/Program.h"

int main(int argc, char** argv) {
  QApplication application(argc, argv);
  Program program;
  return program.Start() ? QApplication::exec() : 1;
}
