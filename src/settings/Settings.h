#pragma once

#include <QDialog>
#include <memory>
#include <optional>

#include "core/data/IniReader.h"
#include "core/text/StringTable.h"
#include "platform/MessageBoxes.h"
#include "platform/SerialDevices.h"
#include "ui/Commands.h"
#include "ui/EntryChecks.h"

namespace Ui {
class Settings;
}

/// Chooses the serial port by number. The list of ports is for display only.
class Settings : public QDialog {
  Q_OBJECT

 public:
  Settings(IniReader& ini, const SerialDevices& devices, MessageBoxes& boxes, const StringTable& strings,
           QWidget* parent);
  ~Settings() override;

 private:
  void ListAvailablePorts(const SerialDevices& devices);
  std::optional<EntryFault> FaultOfPortNumber() const;
  void SaveAndExit();

  std::unique_ptr<Ui::Settings> ui_;
  IniReader& ini_;
  Commands commands_;
  EntryChecks checks_;
};
