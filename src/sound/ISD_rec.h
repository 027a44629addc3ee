#pragma once

#include <QDialog>
#include <chrono>
#include <functional>
#include <memory>
#include <optional>
#include <string>

#include "core/data/IniReader.h"
#include "core/line/CommPortSetting.h"
#include "core/text/StringTable.h"
#include "platform/EventPump.h"
#include "platform/FileDialog.h"
#include "platform/Files.h"
#include "platform/MessageBoxes.h"
#include "platform/MonotonicClock.h"
#include "platform/SerialDevices.h"
#include "platform/SerialPort.h"
#include "platform/SoundConverter.h"
#include "platform/SoundPlayer.h"
#include "platform/WakeLock.h"
#include "sound/PageIndexTable.h"
#include "sound/RecorderLink.h"
#include "sound/SoundList.h"
#include "sound/SoundListModel.h"
#include "sound/SoundPreview.h"
#include "sound/WaveFile.h"
#include "ui/Commands.h"

namespace Ui {
class ISD_rec;
}

class PollTimer;

/// The sounds of a product: which file each sound event has, how much of the sound chip they take, playing
/// them, and recording them on the chip. One job at a time; its waits end when the window is closed.
class ISD_rec : public QDialog, private RecorderDisplay {
  Q_OBJECT

 public:
  /// What the window works with; all of it must outlive the window.
  struct Parts {
    SerialPort& MSComm1;  ///< the window's own
    IniReader& Ini;
    const SerialDevices& Devices;
    EventPump& Events;
    const MonotonicClock& Elapsed;
    MessageBoxes& Boxes;
    FileDialog& CD;
    Files& Disk;
    SoundPlayer& Player;
    const SoundConverter& Converter;
    WakeLock& Awake;
    const StringTable& Strings;
    std::string ProgramFolder;  ///< with the products' definition files
  };

  ISD_rec(const Parts& parts, QWidget* parent);
  /// Stops the sound and closes the line.
  ~ISD_rec() override;

  void reject() override;

 private:
  void FormLoad();
  void ConnectCommands();
  void ShowCommPort();
  void Unload();

  void LoadProduct();
  void ChangeProduct(int index);
  /// Sets the speed of the line if it is open. One that is lost is closed.
  void SetupComm();
  void UpdateUtilisation();

  void OpenOne();
  void SaveList();
  void OpenPlaylist();
  std::string LastFolder() const;
  /// False, after a box, for a path that no play list could give back.
  bool MayBeKept(const std::string& path);

  void PlaySelected(int row);
  void PreviewAll();
  void Record();
  void TestAll();
  /// Runs a job on the line, which is opened if need be.
  void WorkOnLine(const std::function<void(RecorderLink&)>& job);
  RecorderLink Link();

  Recorder SelectedRecorder() const;
  /// The selected row, if there is one.
  std::optional<std::size_t> SelectedRow() const;
  bool StopRequested() const { return commands_.CloseRequested(); }

  // Additions.
  void SetUpAdditions();
  void ShowWhatIsNew();
  void ShowNotes();
  void ShowEstimate();
  void ShowLevel();
  void ShowPlayingTime();
  void ShowProgress(double done, double whole);
  void BeginProgress();
  void HideProgress();
  void ConvertOne();
  /// Converts a sound and gives it to a row. Returns what the operator should read; nothing if the window
  /// closes.
  std::optional<std::string> ConvertInto(const std::string& path, std::size_t row);
  void ShowOutcomes(const std::vector<std::string>& outcomes);
  void TakeDroppedFiles(int row, const QStringList& paths);
  /// Returns the outcome if the file was converted.
  std::optional<std::string> PlaceDroppedFile(const std::string& path, std::size_t row);

  void SetStatus(const std::string& text) override;
  void SetStatus2(const std::string& text) override;
  void SelectRow(std::size_t row) override;
  void PageBegins() override;

  std::unique_ptr<Ui::ISD_rec> ui_;
  const Parts parts_;
  const CommPortSetting port_;
  WaveFile wave_;
  SoundList list_;
  PageIndexTable pageIndexTable_;
  SoundPreview preview_;
  SoundListModel* model_;
  PollTimer* tmrCheck_ = nullptr;  ///< ticks while a sound plays
  int shownProduct_ = 0;
  bool previewing_ = false;       ///< all rows are played
  RecorderLink* link_ = nullptr;  ///< of the job that is on the stack
  std::int64_t pagesToSend_ = 0;  ///< of all rows
  std::int64_t pagesBegun_ = 0;   ///< in the recording that runs
  std::chrono::microseconds jobStart_{0};
  Commands commands_;
};
