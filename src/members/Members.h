#pragma once

#include <QDialog>
#include <functional>
#include <memory>
#include <optional>
#include <string>

#include "core/text/StringTable.h"
#include "members/MemberRows.h"
#include "platform/Clock.h"
#include "platform/Database.h"
#include "platform/FileDialog.h"
#include "platform/Files.h"
#include "platform/MessageBoxes.h"
#include "ui/Commands.h"

namespace Ui {
class Members;
}

/// The members: searched, looked through, edited, and one of them chosen with OK. Has a cursor of its own on
/// the table; the one of the board sees its changes of rows, but not its new rows.
class Members : public QDialog, private BoundControls {
  Q_OBJECT

 public:
  /// What the window works with; it outlives it.
  struct Parts {
    Database& DbMembers;
    MessageBoxes& Boxes;
    FileDialog& CommonDialog1;
    const Files& Disk;
    const Clock& Time;
    const StringTable& Strings;
    /// Waits for a membership button; its number, or NoDallasId. May be empty where there is no reader.
    std::function<std::string()> ButtonSwipe = {};
  };

  Members(Parts parts, QWidget* parent);
  ~Members() override;

  std::int32_t ContactToShow = 0;  ///< member to stand on when the window comes up, 0 for none
  std::string SelectedContact;     ///< `ContactID` of the member chosen with OK, else empty

  void reject() override;

 protected:
  void showEvent(QShowEvent* event) override;
  bool eventFilter(QObject* watched, QEvent* event) override;

 private:
  void ShowRow(Recordset& rows) override;
  void ShowNoRow() override;
  MemberDetails Entered() const override;
  void RowChanged() override;

  void SetCaptions();
  void ConnectCommands();
  /// Runs a command; a failure is told only when the present event is over.
  void RunInFocusChange(const std::function<void()>& command);
  void SetEntriesEnabled(bool enabled);
  void ShowPlace();
  void ShowMemberExtras();
  void ReadPhoto();
  void PreviewPhoto(const std::string& file);

  void Activate();
  bool IsLeaving(Qt::FocusReason reason) const;
  void RunSearch();
  void RunClearSearch();
  void AddMember();
  void DeleteMember();
  void ChangeMemberId();
  void ChangeMemberPicture();
  void SelectMember();

  std::unique_ptr<Ui::Members> ui_;
  const Parts parts_;
  Commands commands_;
  std::optional<MemberRows> data1_;
};
