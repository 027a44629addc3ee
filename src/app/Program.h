#pragma once

#include <QObject>
#include <optional>

#include "app/Composition.h"
#include "app/InstanceCalls.h"
#include "app/frmRx.h"
#include "ui/AltLetters.h"
#include "ui/PlainToolTips.h"

/// One run of the program with the real platform. Needs a QApplication.
class Program : public QObject {
 public:
  Program();

  /// Prepares the main window and shows it. Returns false if the program cannot continue, which has been
  /// reported, or if the operator chose to end it.
  bool Start();

  /// Takes what later starts of the program ask at this socket: see InstanceCalls.
  void Listen(int listener);

  /// Starts, and runs until the main window is closed. Returns the process's exit code.
  int Run();

  frmRx& Window() { return *window_; }

 protected:
  /// Logs the commands of all windows.
  bool eventFilter(QObject* watched, QEvent* event) override;

 private:
  PlainToolTips toolTips_;
  AltLetters altLetters_;
  Composition composition_;
  std::optional<frmRx> window_;
  bool started_ = false;
  std::optional<InstanceCalls> calls_;
};
