#pragma once

#include <QDialog>
#include <QElapsedTimer>
#include <QTimer>
#include <functional>
#include <memory>
#include <optional>
#include <vector>

#include "archive/copies/CopyListModel.h"
#include "archive/copies/CopyWork.h"
#include "platform/EventPump.h"
#include "platform/FileDialog.h"
#include "platform/MessageBoxes.h"
#include "ui/Commands.h"

namespace Ui {
class BackupCopies;
}

/// The copies of the databases: they are listed with what they hold, made, copied elsewhere and restored
/// while the program runs.
class BackupCopies : public QDialog {
  Q_OBJECT

 public:
  struct Parts {
    std::vector<CopiedDatabase> Databases;
    CopyWork::Parts Work;
    EventPump& Events;
    MessageBoxes& Boxes;
    ::FileDialog& FileDialog;
    /// What forbids a restore at the moment; nothing if it is allowed.
    std::function<std::optional<OwnText>()> Busy;
    /// Opens the databases anew; called after a restore.
    std::function<void()> Reopen;
  };

  BackupCopies(Parts parts, QWidget* parent);
  ~BackupCopies() override;

  void reject() override;

 private:
  class Job;

  void SetUpTable();
  void ConnectCommands();
  void Refresh();
  void EnableButtons();
  /// The selected entry, or null.
  const CopyListModel::Entry* Selected() const;

  void Restore();
  bool MayRestore(const CopyListModel::Entry& entry);
  void Tell(const Restored& restored);
  void CopyAll();
  void CopySelected();
  /// Where the operator wants the copy; nothing if nowhere.
  std::optional<std::string> AskTarget(const std::string& name);

  bool KeepOn(CopyStep step);
  CopyWork::OnStep Steps() {
    return [this](CopyStep step) { return KeepOn(step); };
  }
  void ShowStatus(const std::string& text);

  std::unique_ptr<Ui::BackupCopies> ui_;
  const Parts parts_;
  const CopyWork work_;
  CopyListModel list_;
  Commands commands_;
  QTimer countTimer_;
  QElapsedTimer sinceEvents_;
  bool stop_ = false;
};
