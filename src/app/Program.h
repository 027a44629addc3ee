#pragma once

#include <QObject>
#include <optional>

#include "app/Composition.h"
#include "app/frmRx.h"

/// One run of the program with the real platform. Needs a QApplication.
class Program : public QObject {
 public:
  Program();

  /// Gets the main window ready and shows it. Returns false when the program cannot go on, which has been
  /// told, or when the operator chose to end it.
  bool Start();

  /// Starts, and runs until the main window is closed. Returns the process's exit code.
  int Run();

  frmRx& Window() { return *window_; }

 protected:
  /// Sees the commands of all windows, for the log.
  bool eventFilter(QObject* watched, QEvent* event) override;

 private:
  Composition composition_;
  std::optional<frmRx> window_;
};
