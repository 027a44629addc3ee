#pragma once

#include <QDialog>
#include <chrono>
#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "archive/history/ArchivedMembers.h"
#include "archive/history/ForgetMember.h"
#include "archive/history/MemberSessions.h"
#include "core/text/StringTable.h"
#include "platform/Database.h"
#include "platform/EventPump.h"
#include "platform/MessageBoxes.h"
#include "platform/MonotonicClock.h"
#include "ui/Commands.h"

class HistoryRows;
class RunProgress;

namespace Ui {
class MemberHistoryWindow;
}

/// What the kept games tell of each member, and the command that has the archive forget one. The members are
/// those in games, whether they are still members or not.
class MemberHistoryWindow : public QDialog {
  Q_OBJECT

 public:
  struct Parts {
    /// Statements on the archive as it is now. May throw RuntimeError.
    std::function<Sql&()> Archive;
    ForgetMember::Parts Forgetting;
    MessageBoxes& Boxes;
    EventPump& Events;
    const MonotonicClock& Elapsed;
    /// The game on the board is no longer to be kept with these.
    std::function<void(const GamePersons& persons)> NotToKeep;
  };

  /// Shows this member first; 0 for the first one of the list.
  MemberHistoryWindow(const Parts& parts, std::int32_t member, QWidget* parent);
  ~MemberHistoryWindow() override;

  void reject() override;

 private:
  const StringTable& Strings() const { return parts_.Forgetting.Strings; }
  Database& DbMembers() const { return parts_.Forgetting.DbMembers; }
  void SetTexts();
  void SetUpTables();
  void ConnectCharts();
  /// Reads who is in the archive, and shows `member` or the first one. A failure is told in the window.
  void Load(std::int32_t member);
  void Filter();
  void Select(std::int32_t member);
  void ShowCurrent();
  void Show(const ArchivedMember& member);
  void ShowSessions();
  void ShowMonths();
  void ShowBests();
  void Clear();
  QString SessionText(int row, int column) const;
  QString MonthText(int row, int column) const;
  std::string NameOf(const ArchivedMember& member) const;
  void Forget();
  bool MayForget(const std::string& name, int games);
  void ShowForgotten(const Forgotten& forgotten, const std::string& name);
  /// Shows how far it is; false if it is to stop.
  bool ShowStep(const ForgetMember::State& state, RunProgress& progress);
  void EnableEntries(bool enabled);
  void Tell(const std::string& text);

  const Parts parts_;
  std::unique_ptr<Ui::MemberHistoryWindow> ui_;
  Commands commands_;
  HistoryRows* memberRows_;
  HistoryRows* sessionRows_;
  HistoryRows* monthRows_;
  std::vector<ArchivedMember> members_;
  std::vector<std::size_t> found_;  ///< places in members_ that the list shows
  ArchivedMember shown_;            ///< number 0 for none
  MemberSessions sessions_;
  std::chrono::microseconds begun_{0};  ///< when the present part of forgetting was
  bool stopped_ = false;
};
