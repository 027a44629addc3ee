#pragma once

#include <QDialog>
#include <memory>
#include <string>

#include "core/text/StringTable.h"

namespace Ui {
class MissionNameEntry;
}

/// Asks for the name of a new mission.
class MissionNameEntry : public QDialog {
  Q_OBJECT

 public:
  MissionNameEntry(const StringTable& strings, QWidget* parent);
  ~MissionNameEntry() override;

  /// The name typed; empty unless the operator pressed OK.
  std::string EnteredName() const;

 private:
  std::unique_ptr<Ui::MissionNameEntry> ui_;
};
