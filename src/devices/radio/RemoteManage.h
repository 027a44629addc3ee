#pragma once

#include <QDialog>
#include <functional>
#include <memory>

#include "core/game/Game.h"
#include "core/line/CommPort.h"
#include "core/text/StringTable.h"
#include "devices/radio/GunTable.h"
#include "devices/radio/RadioDisplay.h"
#include "platform/Clock.h"
#include "platform/EventPump.h"
#include "platform/MessageBoxes.h"
#include "platform/SerialPort.h"
#include "ui/Commands.h"

class GunListModel;
class RadioLink;

namespace Ui {
class RemoteManage;
}

/// The guns in radio range, and their scores. Both buttons stay enabled during a run; a later run ends the
/// earlier one, and Stop the one that is running. If closed during a run, the window goes once the run has
/// unwound; Escape does not close it then.
class RemoteManage : public QDialog, private RadioDisplay {
  Q_OBJECT

 public:
  /// What the window works with; all of it must outlive the window.
  struct Parts {
    SerialPort& MSComm1;
    CommPort& Port;
    EventPump& Events;
    MessageBoxes& Boxes;
    const Clock& Time;
    const StringTable& Strings;
    ::Game& Game;
    /// Hears the record of each gun right before its scores are added to the game.
    std::function<void(int)> BeforeGun = {};
    /// Hears, while scores are fetched, of how many of the guns present they are there.
    std::function<void(int fetched, int present)> Fetching = {};
    /// Hears the end of each fetch, however it ends.
    std::function<void()> FetchEnded = {};
  };

  RemoteManage(const Parts& parts, QWidget* parent);
  ~RemoteManage() override;

  void reject() override;

 protected:
  bool eventFilter(QObject* watched, QEvent* event) override;

 private:
  void SetUpList();
  void ShareListWidth();
  /// The window's font, `size` times as large.
  QFont ListFont(double size) const;
  /// Gives the list letters in which no text is wider than this.
  void FitLetters(int columnWidth);
  void SearchForGuns();
  void GetScores();
  /// Runs a job on a link of its own. However it ends, the line is closed and the pointer restored.
  void Work(const std::function<void(RadioLink&)>& job);
  void StopRun();
  bool IsStopped(int run) const { return run <= stoppedRun_; }
  /// Shows a remark of the window's own below its status; none if it is empty.
  void ShowHint(const std::string& text);
  int GunsPresent() const;
  int GunsFetched() const;

  void SetStatus(const std::string& text) override;
  void SetPlayersFound(int count) override;
  void ClearGunList() override;
  void RefreshGunList() override;
  void SetProgress(const std::string& text, int step, int steps) override;

  std::unique_ptr<Ui::RemoteManage> ui_;
  const Parts parts_;
  GunListModel* list_ = nullptr;
  GunTable guns_;
  std::int16_t maxPlayerId_;  ///< 128 or 224: number of ids that the last search tried
  int latestRun_ = 0;
  int fetchRun_ = 0;    ///< the latest that fetched scores
  int stoppedRun_ = 0;  ///< the last run that the operator stopped
  Commands commands_;
};
