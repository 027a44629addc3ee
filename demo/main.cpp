#include <QApplication>
#include <QDir>
#include <cstdio>

#include "app/Program.h"
#include "demo/DemoRun.h"
#include "demo/EveningRun.h"

namespace {

constexpr const char* Usage =
    "usage: tessarine-demo [--radio] FOLDER\n"
    "       tessarine-demo --evening GAMES PLAYERS SEED FILE FOLDER\n";

/// What the arguments ask for.
struct Asked {
  DemoSource Source = DemoSource::BaseUnit;
  int Games = 0;  ///< of an evening; 0 for the one game of the demo
  VenuesEvening Evening;
  QDir Folder;
  bool IsClear = false;
};

Asked AskedBy(QStringList arguments) {
  Asked asked;
  if (arguments.size() == 6 && arguments.first() == QStringLiteral("--evening")) {
    asked.Games = arguments[1].toInt();
    asked.Evening = {arguments[2].toInt(), arguments[3].toUInt(), arguments[4]};
    asked.Folder = QDir(arguments[5]);
    asked.IsClear =
        asked.Games > 0 && asked.Games <= static_cast<int>(EveningGames::Most) && asked.Folder.exists();
    return asked;
  }
  asked.Source =
      arguments.removeAll(QStringLiteral("--radio")) > 0 ? DemoSource::Radio : DemoSource::BaseUnit;
  asked.IsClear = arguments.size() == 1 && QDir(arguments.first()).exists();
  asked.Folder = QDir(arguments.value(0));
  return asked;
}

}  // namespace

/// tessarine-demo [--radio] FOLDER: takes one game from the download to the score sheets without an operator,
/// and leaves the results in FOLDER.
/// tessarine-demo --evening GAMES PLAYERS SEED FILE FOLDER: pulls so many games of the simulated venue's
/// evening, which prints into FILE, and checks that board, pages and archive agree.
int main(int argc, char** argv) {
  QApplication::setAttribute(Qt::AA_DontUseNativeDialogs);
  QApplication application(argc, argv);
  const Asked asked = AskedBy(QApplication::arguments().mid(1));
  if (!asked.IsClear) {
    std::fputs(Usage, stderr);
    return 2;
  }
  Program program;
  if (!program.Start()) {
    return 1;
  }
  const QStringList faults = asked.Games > 0
                                 ? EveningRun(program.Window(), asked.Evening, asked.Folder).Run(asked.Games)
                                 : DemoRun(program.Window(), asked.Source, asked.Folder).Run();
  for (const QString& fault : faults) {
    std::fprintf(stderr, "%s\n", qUtf8Printable(fault));
  }
  return faults.isEmpty() ? 0 : 1;
}
