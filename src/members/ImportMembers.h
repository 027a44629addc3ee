#pragma once

#include <QDialog>
#include <QTimer>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "core/text/StringTable.h"
#include "members/MemberImport.h"
#include "platform/Clock.h"
#include "platform/Database.h"
#include "platform/EventPump.h"
#include "platform/MessageBoxes.h"
#include "ui/Commands.h"

class PlannedRowsModel;
class RunProgress;
class QComboBox;

namespace Ui {
class ImportMembers;
}

/// Imports members from a CSV file: shows which column goes where and what becomes of each line, anew after
/// each change of a choice, and then does all of it or nothing.
class ImportMembers : public QDialog {
  Q_OBJECT

 public:
  /// All but the function and the file must outlive the window.
  struct Parts {
    Database& DbMembers;
    MessageBoxes& Boxes;
    EventPump& Events;
    const Clock& Time;
    const StringTable& Strings;
    /// Keeps a copy of the members before they are changed. False if it was stopped. Throws RuntimeError if
    /// it cannot.
    std::function<bool(const KeepOn& keepOn)> BackUp;
  };

  /// `bytes` are those of the file at `path`.
  ImportMembers(Parts parts, const std::string& path, std::string bytes, QWidget* parent);
  ~ImportMembers() override;

  /// True once members were added or changed.
  bool HasImported() const { return hasImported_; }

  void reject() override;

 protected:
  void showEvent(QShowEvent* event) override;

 private:
  void SetCaptions(const std::string& path);
  void ConnectControls();
  void FillLists();
  /// Lists the file's columns as the present separator divides them.
  void ListColumns();
  QComboBox* UseList(int column) const;
  ImportChoices Choices() const;
  /// The member column to which two of the file's go; nothing if there is none.
  std::optional<std::size_t> ColumnUsedTwice(const ColumnUse& use) const;

  void ChooseOrder(DateOrder order);
  void EnableChoices(bool enabled);
  /// Forgets the last check and starts another one soon, stopping the present one.
  void CheckSoon();
  void Check();
  /// Looks at the dates and shows what it found. Returns false if the check ends with that.
  bool SettleDates(const GoOn& goOn);
  void ShowPlan();
  void Import();
  /// Returns false, having told why, if there is no copy.
  bool BackUp(RunProgress& progress);
  void ShowState(const std::string& text);

  std::unique_ptr<Ui::ImportMembers> ui_;
  const Parts parts_;
  Commands commands_;
  MemberImport import_;
  std::optional<ImportPlan> plan_;
  std::optional<DateOrder> chosenOrder_;  ///< by the operator, where the file leaves it open
  std::unique_ptr<PlannedRowsModel> rows_;
  QTimer checkTimer_;
  bool stopped_ = false;
  bool hasImported_ = false;
};
