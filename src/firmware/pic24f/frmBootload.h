#pragma once

#include <QDialog>
#include <array>
#include <functional>
#include <memory>
#include <string>

#include "core/data/IniReader.h"
#include "core/text/StringTable.h"
#include "firmware/hex/ImageComparison.h"
#include "firmware/pic24f/BootMenus.h"
#include "firmware/pic24f/DeviceSelector.h"
#include "firmware/pic24f/PicComms.h"
#include "platform/EventPump.h"
#include "platform/FileDialog.h"
#include "platform/MessageBoxes.h"
#include "platform/Programs.h"
#include "platform/RuntimeError.h"
#include "platform/SerialDevices.h"
#include "ui/Commands.h"

class QLabel;

namespace Ui {
class frmBootload;
}

/// The firmware update of devices with a PIC24F boot loader: import a HEX file, connect, write, erase, run.
/// All but the choice of the file is done from the tool bar, and every outcome is told in the first panel of
/// the status bar. Closed during an operation, the window goes once that has unwound.
class frmBootload : public QDialog {
  Q_OBJECT

 public:
  /// What the window works with; all of it must outlive the window.
  struct Parts {
    /// Makes the boot loader's library; its waits end when `stopped` says so.
    std::function<std::unique_ptr<PicBoot>(std::function<bool()> stopped)> MakeLibrary;
    Files& Disk;
    EventPump& Events;
    FileDialog& CommonDialog1;
    MessageBoxes& Boxes;
    Programs& OtherPrograms;
    const IniReader& Ini;
    const SerialDevices& Devices;
    const StringTable& Strings;
    BootFolder Folder;
    /// Without one a connection ends where the configuration bytes are listed.
    DeviceSelector* Selector = nullptr;
  };

  frmBootload(const Parts& parts, QWidget* parent);
  ~frmBootload() override;

  void reject() override;

 protected:
  bool eventFilter(QObject* watched, QEvent* event) override;

 private:
  void SetUpPanels();
  void SetUpToolbar();
  void GiveToolbarToTheKeyboard();
  void ConnectMenus();
  void LoadSettings();
  DeviceSelector& Selector() const;

  void Browse();
  void ShowLostBytes(const std::vector<LostStretch>& lost);
  void SetPort(std::size_t index);
  void SetBitRate(std::size_t index);
  void PopUp(int panel, const QPoint& place);

  void ConnectOrDisconnect();
  void ConnectDevice();
  void FindDevice();
  void ListConfigBytes();
  void DisconnectDevice();
  void Write();
  /// Writes the memories that are chosen. Returns false if they differ from the images afterwards.
  bool WriteMemories();
  void Erase();
  void RunDevice();
  void ShowLog();
  /// Runs an operation with the pointer and the controls of one. After a failure of the line the port is
  /// closed.
  void Operate(const std::function<void()>& operation);
  void ForgetLostPort(const RuntimeError& error);

  void SetUiState(std::uint8_t flags);
  void SetUiStateOfDevice();
  void SetStatus(const std::string& text);

  std::unique_ptr<Ui::frmBootload> ui_;
  const Parts parts_;
  BootMenus menus_;
  const std::unique_ptr<PicBoot> library_;
  PicComms comms_;
  const BootIni ini_;
  std::array<QLabel*, 5> panels_{};
  int panel_ = 0;  ///< clicked last, from 1
  std::string deviceName_;
  std::string resetVectorText_;
  Commands commands_;
};
