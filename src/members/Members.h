#pragma once

#include <QDialog>
#include <functional>
#include <memory>
#include <optional>
#include <string>

#include "core/text/StringTable.h"
#include "members/MemberCursor.h"
#include "platform/Clock.h"
#include "platform/Database.h"
#include "platform/FileDialog.h"
#include "platform/Files.h"
#include "platform/MessageBoxes.h"
#include "ui/Commands.h"
#include "ui/PollTimer.h"

namespace Ui {
class Members;
}

/// The window in which members are searched, browsed and edited, and one of them chosen with OK. It has its
/// own cursor on the table; the board's cursor sees rows changed here, but not rows added here.
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
    /// Waits for a membership button and returns its number, or NoDallasId. May be empty if there is no
    /// reader.
    std::function<std::string()> ButtonSwipe = {};
    /// Shows the games of a member in front of a window. May be empty.
    std::function<void(std::int32_t contactId, QWidget& parent)> ShowHistory = {};
  };

  Members(Parts parts, QWidget* parent);
  ~Members() override;

  std::int32_t ContactToShow = 0;  ///< member to show when the window opens, 0 for the first

  /// `ContactID` of the member chosen with OK, else empty.
  const std::string& SelectedContact() const { return selectedContact_; }

  void reject() override;

 protected:
  void showEvent(QShowEvent* event) override;
  bool focusNextPrevChild(bool next) override;
  bool eventFilter(QObject* watched, QEvent* event) override;

 private:
  void ShowRow(Recordset& rows) override;
  void ShowNoRow() override;
  MemberDetails Entered() const override;
  void RowChanged() override;

  void SetCaptions();
  void ReserveRoomForFigures();
  void ConnectCommands();
  /// Runs a command, but reports a failure only after the current event: a box must not open during a focus
  /// change.
  void RunInFocusChange(const std::function<void()>& command);
  /// Enables what needs a current row.
  void SetRowEnabled(bool enabled);
  void ShowPlace();
  void ShowMemberExtras();
  void ReadPhoto();
  void PreviewPhoto(const std::string& file);

  void SetUpList();
  /// The list of members finds anew what the search box holds.
  void ListHits();
  /// Shows in the form the member chosen in the list.
  void ShowHit(std::int64_t contactId);
  void ShowMemberInList();
  /// Shows the list's rows anew if one was written back.
  void RefreshList();
  void EnterList();

  void Activate();
  bool IsLeaving(Qt::FocusReason reason) const;
  void RunSearch();
  /// The search, and the list of members with it.
  void SearchByCommand();
  void RunClearSearch();
  void AddMember();
  void DeleteMember();
  void ChangeMemberId();
  void ChangeMemberPicture();
  void SelectMember();
  void ShowGames();

  std::unique_ptr<Ui::Members> ui_;
  const Parts parts_;
  Commands commands_;
  std::optional<MemberCursor> data1_;
  std::string selectedContact_;
  int writtenBack_ = 0;     ///< changes of the form that the list shows
  PollTimer* listTimer_;    ///< runs while the operator's typing pauses
  PollTimer* detailTimer_;  ///< runs while rows of the list lack their photos and marks
};
