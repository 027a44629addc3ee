#pragma once

#include <QAction>
#include <QMenu>
#include <array>

class QWidget;

/// The pop-up menus of the boot loader's window. Items of arrays are counted from 1 in their names and from 0
/// here.
struct BootMenus {
  /// `parent` owns the menus.
  explicit BootMenus(QWidget* parent);

  QMenu* M_PortSettings;
  std::array<QAction*, 4> M_FPPort;

  QMenu* M_BitRateSettings;
  std::array<QAction*, 8> M_FPBaud;

  QMenu* M_Program;
  QAction* M_PDevSelector;
  QAction* space104;
  std::array<QAction*, 4> M_MemAccess;  ///< FLASH, EEDATA, CONFIG, USERID
  QAction* space101;
  QAction* M_PSendCfg;
  QAction* space102;
  QAction* M_About;
};
