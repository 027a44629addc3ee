#pragma once

#include <QDialog>
#include <memory>
#include <string>
#include <vector>

#include "core/text/StringTable.h"
#include "members/MemberExport.h"
#include "platform/Clock.h"
#include "platform/Database.h"
#include "platform/EventPump.h"
#include "platform/FileDialog.h"
#include "platform/Files.h"
#include "platform/MessageBoxes.h"
#include "ui/Commands.h"

namespace Ui {
class ExportMembers;
}

/// Asks how to export the members and writes them to a CSV file that the operator alone can read. The choices
/// are not remembered.
class ExportMembers : public QDialog {
  Q_OBJECT

 public:
  /// All of them must outlive the window.
  struct Parts {
    Database& DbMembers;
    MessageBoxes& Boxes;
    FileDialog& CommonDialog1;
    Files& Disk;
    EventPump& Events;
    const Clock& Time;
    const StringTable& Strings;
  };

  ExportMembers(const Parts& parts, QWidget* parent);
  ~ExportMembers() override;

  void reject() override;

 private:
  void SetCaptions();
  void Export();
  void EnableChoices(bool enabled);
  /// The file that the operator chooses; empty for none.
  std::string AskForPath();
  void ShowState(const std::string& text);
  /// Writes the members to `path`. Returns false if it was stopped.
  bool WriteTo(const std::string& path);

  std::unique_ptr<Ui::ExportMembers> ui_;
  const Parts parts_;
  Commands commands_;
  std::unique_ptr<Recordset> rows_;
  std::vector<std::string>
      notReadBack_;  ///< numbers of members whom an import would not give back as they are
  bool stopped_ = false;
};
