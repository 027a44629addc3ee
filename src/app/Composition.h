#pragma once

#include <QTranslator>

#include "app/ConversionWithProgress.h"
#include "app/Services.h"
#include "check/FailureBoxes.h"
#include "core/data/LoggedBoxes.h"
#include "core/data/ProgramLog.h"
#include "core/line/LoggedPort.h"
#include "core/text/StringTable.h"
#include "devices/buttons/SerialOneWire.h"
#include "platform/libreoffice/LibreOffice.h"
#include "platform/linux/KeptProgram.h"
#include "platform/linux/LinuxAddresses.h"
#include "platform/linux/LinuxComputer.h"
#include "platform/linux/LinuxFiles.h"
#include "platform/linux/LinuxPrograms.h"
#include "platform/qt/DBusWakeLock.h"
#include "platform/qt/QtClock.h"
#include "platform/qt/QtEventPump.h"
#include "platform/qt/QtFileDialog.h"
#include "platform/qt/QtFolders.h"
#include "platform/qt/QtMessageBoxes.h"
#include "platform/qt/QtSerialDevices.h"
#include "platform/qt/QtSerialPort.h"
#include "platform/qt/QtSoundPlayer.h"
#include "platform/sndfile/SndfileConverter.h"
#include "platform/sqlite/SqliteDatabase.h"
#include "ui/DialogParent.h"

/// The real platform, assembled for one run of the program. Needs a QApplication.
class Composition {
 public:
  Composition();

  ::Services Services();

  /// Boxes and dialogs belong to `window` while no other window is active.
  void SetMainWindow(QWidget* window) { parent_.SetMainWindow(window); }

  /// Called after a serial port could not be opened or was lost, and before a box that tells of a failure
  /// which System Check may explain.
  std::function<void()> OnFailure;

  MessageBoxes& Boxes() { return failureBoxes_; }
  ProgramLog& Log() { return log_; }

 private:
  std::string SwipeButton();
  void TellFailure() const;
  /// What is done after each attempt to open a port.
  std::function<void(const std::string& device, const std::string& settings, int fault)> NoteOpening();
  /// The same where the log would have too many rows of it.
  std::function<void(const std::string& device, const std::string& settings, int fault)> NoteFault();

  StringTable strings_;
  QTranslator dialogTexts_;  ///< the toolkit's own texts ("OK", "File name:") in the program's language
  QtClock clock_;
  SqliteEngine databases_;
  SqliteEngine archives_{std::chrono::milliseconds(50)};  // games are kept between two commands
  QtEventPump events_;
  DialogParent parent_;
  QtFileDialog fileDialog_{[this] { return parent_.Window(); }};
  LinuxFiles files_;
  ConversionWithProgress old_{strings_, files_};
  QtFolders folders_;
  ProgramLog log_;
  QtMessageBoxes shownBoxes_{[this] { return parent_.Window(); }};
  LoggedBoxes boxes_{shownBoxes_, log_};
  FailureBoxes failureBoxes_{boxes_, strings_, [this] { TellFailure(); }};
  LinuxPrograms otherPrograms_;
  LinuxComputer computer_;
  QtSerialDevices devices_;
  const std::string logFolder_;
  QtSerialPort port_;
  LoggedPort loggedPort_{port_,
                         {.Disk = files_,
                          .Folder = logFolder_,
                          .Elapsed = events_,
                          .Time = clock_,
                          .OnOpening = NoteOpening(),
                          .OnLost = [this] { TellFailure(); }},
                         "line"};
  QtSerialPort readerPort_;
  LoggedPort loggedReaderPort_{readerPort_,
                               {.Disk = files_,
                                .Folder = logFolder_,
                                .Elapsed = events_,
                                .Time = clock_,
                                .OnOpening = NoteFault(),
                                .OnLost = [this] { TellFailure(); }},
                               "1-wire",
                               Transcript::Repeats::Counted};
  IniReader readerSettings_;
  SerialOneWire wire_{loggedReaderPort_, events_, readerSettings_, devices_};
  LibreOffice wordProcessor_;
  DBusWakeLock awake_;
  QtSerialPort soundPort_;
  LoggedPort loggedSoundPort_{soundPort_,
                              {.Disk = files_,
                               .Folder = logFolder_,
                               .Elapsed = events_,
                               .Time = clock_,
                               .OnOpening = NoteOpening(),
                               .OnLost = [this] { TellFailure(); }},
                              "sound-recorder"};
  QtSoundPlayer soundPlayer_;
  SndfileConverter soundConverter_;
  LinuxAddresses addresses_;
  KeptProgram resultsProgram_;
};
