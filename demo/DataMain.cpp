#include <QCoreApplication>
#include <QDate>
#include <QSaveFile>
#include <cstdio>
#include <exception>
#include <stdexcept>

#include "demo/DemoMembers.h"
#include "demo/DemoMission.h"
#include "demo/MemberButtons.h"
#include "demo/MemberRows.h"
#include "platform/linux/LinuxFiles.h"
#include "platform/sqlite/SqliteDatabase.h"
#include "sim/game/GameMaker.h"

namespace {

/// Nobody is there to answer.
class BoxesAsFailures : public MessageBoxes {
 public:
  BoxAnswer Show(const std::string& text, const std::string& /*title*/, BoxIcon /*icon*/,
                 BoxButtons /*buttons*/) override {
    throw std::runtime_error(text);
  }
};

void WriteText(const QString& path, const QString& text) {
  QSaveFile file(path);
  if (!file.open(QIODevice::WriteOnly) || file.write(text.toUtf8()) < 0 || !file.commit()) {
    throw std::runtime_error(path.toStdString() + ": " + file.errorString().toStdString());
  }
}

void MakeData(const std::string& folder, const std::vector<sim::GunScores>& game, const QString& owners) {
  SqliteEngine databases;
  AddMission(*databases.OpenDatabase(folder + "/scenarios.mdb"));
  const auto dbMembers = databases.OpenDatabase(folder + "/members.mdb");
  LinuxFiles disk;
  BoxesAsFailures boxes;
  const std::vector<DemoMember>& members = DemoMembers();
  AddMembers({*dbMembers, disk, boxes}, members, MemberButtons(game, members.size()), QDate::currentDate());
  WriteText(owners, ButtonOwners(*dbMembers->OpenRecordset("Members")));
}

}  // namespace

/// tessarine-demo-data PLAYERS SEED FOLDER FILE: adds the demo's mission and members to the databases in
/// FOLDER, those members with the buttons of this simulated game, and writes to FILE who owns which.
int main(int argc, char** argv) {
  const QCoreApplication application(argc, argv);
  const QStringList arguments = QCoreApplication::arguments().mid(1);
  if (arguments.size() != 4) {
    std::fprintf(stderr, "usage: tessarine-demo-data PLAYERS SEED FOLDER FILE\n");
    return 2;
  }
  try {
    const auto game = sim::MakeGame(arguments[0].toInt(), arguments[1].toUInt());
    MakeData(arguments[2].toStdString(), game, arguments[3]);
  } catch (const std::exception& error) {
    std::fprintf(stderr, "%s\n", error.what());
    return 1;
  }
  return 0;
}
