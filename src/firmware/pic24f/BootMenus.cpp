#include "firmware/pic24f/BootMenus.h"

namespace {

QMenu* NewMenu(QWidget* parent, const char* name, const char* caption) {
  auto* menu = new QMenu(QString::fromLatin1(caption), parent);
  menu->setObjectName(QString::fromLatin1(name));
  return menu;
}

QAction* AddItem(QMenu& menu, const QString& name, const char* caption) {
  QAction* item = menu.addAction(QString::fromLatin1(caption));
  item->setObjectName(name);
  return item;
}

QAction* AddSeparator(QMenu& menu, const char* name) {
  QAction* separator = menu.addSeparator();
  separator->setObjectName(QString::fromLatin1(name));
  return separator;
}

template <std::size_t Count>
std::array<QAction*, Count> AddItems(QMenu& menu, const char* name,
                                     const std::array<const char*, Count>& captions) {
  std::array<QAction*, Count> items{};
  for (std::size_t i = 0; i < Count; ++i) {
    items[i] = AddItem(menu, QString::fromLatin1(name) + QString::number(i + 1), captions[i]);
  }
  return items;
}

}  // namespace

BootMenus::BootMenus(QWidget* parent)
    : M_PortSettings(NewMenu(parent, "M_PortSettings", "PortSettings")),
      M_FPPort(AddItems<4>(*M_PortSettings, "M_FPPort", {"COM1", "COM2", "COM3", "COM4"})),
      M_BitRateSettings(NewMenu(parent, "M_BitRateSettings", "BitRatetSettings")),
      M_FPBaud(AddItems<8>(*M_BitRateSettings, "M_FPBaud",
                           {"1200", "2400", "4800", "9600", "19200", "38400", "57600", "115200"})),
      M_Program(NewMenu(parent, "M_Program", "Program")),
      M_PDevSelector(AddItem(*M_Program, QStringLiteral("M_PDevSelector"), "Device Selector")),
      space104(AddSeparator(*M_Program, "space104")),
      M_MemAccess(AddItems<4>(*M_Program, "M_MemAccess", {"FLASH", "EEDATA", "CONFIG", "USERID"})),
      space101(AddSeparator(*M_Program, "space101")),
      M_PSendCfg(AddItem(*M_Program, QStringLiteral("M_PSendCfg"), "Send Config")),
      space102(AddSeparator(*M_Program, "space102")),
      M_About(AddItem(*M_Program, QStringLiteral("M_About"), "About")) {
  for (QAction* port : M_FPPort) {
    port->setCheckable(true);
  }
  for (QAction* memory : M_MemAccess) {
    memory->setCheckable(true);
  }
  M_MemAccess[0]->setChecked(true);
}
