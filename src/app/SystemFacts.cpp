#include "app/SystemFacts.h"

#include <QGuiApplication>
#include <QLocale>
#include <QScreen>
#include <QSysInfo>

#include "app/ScreenFit.h"
#include "app/Version.h"

namespace {

QString ScreenText(const QScreen& screen) {
  const QSize pixels = PixelsOf(screen);
  return QStringLiteral("Screen %1 x %2, scale %3")
      .arg(pixels.width())
      .arg(pixels.height())
      .arg(screen.devicePixelRatio());
}

}  // namespace

std::vector<std::string> SystemFacts() {
  std::vector<std::string> facts = {
      std::string("Tessarine ") + VersionText,
      std::string("Qt ") + qVersion() + ", " + QGuiApplication::platformName().toStdString(),
      QSysInfo::prettyProductName().toStdString() + ", " + QSysInfo::kernelType().toStdString() + ' ' +
          QSysInfo::kernelVersion().toStdString(),
      "Locale " + QLocale::system().name().toStdString()};
  for (const QScreen* screen : QGuiApplication::screens()) {
    facts.push_back(ScreenText(*screen).toStdString());
  }
  return facts;
}
