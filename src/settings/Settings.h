#pragma once

#include <QDialog>
#include <memory>

#include "core/data/IniReader.h"
#include "core/text/StringTable.h"
#include "platform/MessageBoxes.h"
#include "platform/SerialDevices.h"

namespace Ui {
class Settings;
}

/// Chooses the serial port by number. The list of ports is for looking only.
class Settings : public QDialog {
  Q_OBJECT

 public:
  Settings(IniReader& ini, const SerialDevices& devices, MessageBoxes& boxes, const StringTable& strings,
           QWidget* parent);
  ~Settings() override;

 protected:
  bool eventFilter(QObject* watched, QEvent* event) override;

 private:
  void ListAvailablePorts(const SerialDevices& devices);
  /// The check made when the entry is left: says what is wrong, keeps the focus there, and returns false.
  bool ValidateCommPortNumber();
  void SaveAndExit();

  std::unique_ptr<Ui::Settings> ui_;
  IniReader& ini_;
  MessageBoxes& boxes_;
};
