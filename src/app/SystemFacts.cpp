#include "app/SystemFacts.h"

#include <QFontDatabase>
#include <QGuiApplication>
#include <QLocale>
#include <QScreen>
#include <QSysInfo>

#include "app/Release.h"
#include "app/ScreenFit.h"

namespace {

QString ScreenText(const QScreen& screen) {
  const QSize pixels = PixelsOf(screen);
  return QStringLiteral("Screen %1 x %2, scale %3")
      .arg(pixels.width())
      .arg(pixels.height())
      .arg(screen.devicePixelRatio());
}

}  // namespace

Language LanguageOfSystem() {
  const QStringList languages = QLocale::system().uiLanguages();
  return LanguageOf(languages.isEmpty() ? std::string() : languages.first().toStdString());
}

std::vector<std::string> SystemFacts() {
  std::vector<std::string> facts = {
      "Tessarine " + ReleaseText(),
      std::string("Qt ") + qVersion() + ", " + QGuiApplication::platformName().toStdString(),
      QSysInfo::prettyProductName().toStdString() + ", " + QSysInfo::kernelType().toStdString() + ' ' +
          QSysInfo::kernelVersion().toStdString(),
      "Locale " + QLocale::system().name().toStdString()};
  for (std::string& screen : ScreenTexts()) {
    facts.push_back(std::move(screen));
  }
  return facts;
}

std::vector<std::string> ScreenTexts() {
  std::vector<std::string> texts;
  for (const QScreen* screen : QGuiApplication::screens()) {
    texts.push_back(ScreenText(*screen).toStdString());
  }
  return texts;
}

std::string ChineseLetters() {
  const QStringList families = QFontDatabase::families(QFontDatabase::SimplifiedChinese);
  return families.isEmpty() ? std::string() : families.first().toStdString();
}
