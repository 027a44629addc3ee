#include "demo/MemberRows.h"

#include <QDateTime>
#include <cstdint>

#include "core/data/FieldValue.h"
#include "core/data/Photo.h"

namespace {

/// Figures as if every game had been an average one.
void SetHistory(Recordset& row, const DemoMember& member, const QDate& today) {
  const double games = member.Games;
  const double damage = member.DamagePerGame;
  const double soldiering = member.SoldieringPerGame;
  const QDateTime lastPlayed(today.addDays(-member.DaysSincePlayed), QTime(21, 5));
  row.SetField("DateJoined", member.DateJoined);
  row.SetField("LastPlayedDate", lastPlayed.toString(QStringLiteral("yyyy-MM-dd HH:mm:ss")).toStdString());
  row.SetField("TotalGamesPlayed", std::int64_t{member.Games});
  row.SetField("AverageDamage", damage);
  row.SetField("TotalDamage", games * damage);
  row.SetField("AverageSoldiering", soldiering);
  row.SetField("TotalSoldiering", games * soldiering);
  row.SetField("AveragePrimAccuracy", member.Accuracy);
  row.SetField("TotalPrimaryAccuracy", games * member.Accuracy);
}

void SetPhotograph(Recordset& row, const DemoMember& member, const MemberStore& store) {
  const std::string file = store.Disk.MakeTempFileName();
  store.Disk.Write(file, PortraitFile(member.Look).toStdString());
  StorePhoto(file, row, "Photograph", "PhotographLength", store.Disk, store.Boxes);
  store.Disk.Delete(file);
}

}  // namespace

void AddMembers(const MemberStore& store, const std::vector<DemoMember>& members,
                const std::vector<std::string>& buttons, const QDate& today) {
  const auto rows = store.DbMembers.OpenRecordset("Members");
  WriteScope together(store.DbMembers);
  for (std::size_t i = 0; i < members.size(); ++i) {
    rows->AddNew();
    SetChanges(*rows, {}, members[i].Details);
    rows->SetField("DallasID", buttons.at(i));
    SetHistory(*rows, members[i], today);
    SetPhotograph(*rows, members[i], store);
    rows->Update();
  }
  together.Commit();
}

QString ButtonOwners(Recordset& members) {
  std::string text = "Button\tMember number\tNickname\tNames\n";
  for (members.MoveFirst(); !members.Eof(); members.MoveNext()) {
    const auto column = [&members](const char* name) { return TextOf(members.Fields(name)); };
    text += column("DallasID") + '\t' + column("ContactID") + '\t' + column("NickName") + '\t' +
            column("FirstName") + ' ' + column("LastName") + '\n';
  }
  return QString::fromStdString(text);
}
