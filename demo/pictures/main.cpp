#include <QApplication>
#include <QDir>
#include <QFile>
#include <QProcess>
#include <cstdio>

#include "app/Program.h"
#include "demo/pictures/Pictures.h"

namespace {

QStringList VenueArguments(const QDir& links) {
  QStringList arguments = {QStringLiteral("--players"), QStringLiteral("12"),
                           QStringLiteral("--seed"),    QStringLiteral("5"),
                           QStringLiteral("--link"),    links.absoluteFilePath(QStringLiteral("base-unit"))};
  for (const char* device : {"radio", "onewire", "box", "bootcode"}) {
    const QString option = QStringLiteral("--") + QLatin1String(device);
    arguments << option << option + QStringLiteral("-link") << links.absoluteFilePath(QLatin1String(device));
  }
  arguments << QStringLiteral("--bootcode-power-on") << QStringLiteral("800");
  return arguments;
}

bool Start(QProcess& venue, const QString& program, const QDir& links) {
  venue.setProcessChannelMode(QProcess::ForwardedErrorChannel);
  venue.start(program, VenueArguments(links));
  return venue.waitForStarted() &&
         QTest::qWaitFor([&] { return QFile::exists(links.absoluteFilePath(QStringLiteral("bootcode"))); });
}

}  // namespace

/// tessarine-pictures VENUE LINKS FOLDER: takes the pictures of the operator's manual in the language of the
/// system's locale and leaves them in FOLDER. VENUE is the program of the simulated venue, whose devices
/// appear in LINKS, where the settings expect them.
int main(int argc, char** argv) {
  QApplication::setAttribute(Qt::AA_DontUseNativeDialogs);
  QApplication application(argc, argv);
  const QStringList arguments = QApplication::arguments().mid(1);
  if (arguments.size() != 3 || !QDir(arguments[2]).exists()) {
    std::fprintf(stderr, "usage: tessarine-pictures VENUE LINKS FOLDER\n");
    return 2;
  }
  QProcess venue;
  Program program;
  if (!Start(venue, arguments[0], QDir(arguments[1])) || !program.Start()) {
    return 1;
  }
  Studio studio(program.Window(), QDir(arguments[2]));
  constexpr QSize size(1240, 920);
  program.Window().resize(size);
  TakeDesk(studio);
  TakeEquipment(studio, [&venue](const QString& command) { venue.write(command.toUtf8() + '\n'); });
  for (const QString& fault : studio.Faults()) {
    std::fprintf(stderr, "%s\n", qUtf8Printable(fault));
  }
  venue.terminate();
  venue.waitForFinished();
  return studio.Faults().isEmpty() ? 0 : 1;
}
