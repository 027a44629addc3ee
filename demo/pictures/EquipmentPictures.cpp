#include <QComboBox>
#include <QElapsedTimer>
#include <QLineEdit>
#include <QPushButton>
#include <QRadioButton>
#include <QTableView>
#include <QTableWidget>

#include "demo/pictures/Pictures.h"
#include "demo/pictures/Props.h"

namespace {

using Tell = std::function<void(const QString& command)>;

int GunsFetched(const QAbstractItemModel& guns) {
  constexpr int status = 4;
  int fetched = 0;
  for (int row = 0; row < guns.rowCount(); ++row) {
    fetched += guns.index(row, status).data().toString() == QStringLiteral("Scores OK") ? 1 : 0;
  }
  return fetched;
}

void TakeRadio(Studio& studio) {
  ChoosePort(studio, VenuePort::Radio);
  studio.Open("mnuRemoteManage", [&](QWidget& window) {
    In<QRadioButton>(window, "Guns224").setChecked(true);
    Press<QPushButton>(window, "SearchGunsButton");
    constexpr int enough = 7;
    studio.TakeWhen(
        "RemoteManage", "remote-manage",
        [](QWidget& radio) { return GunsFetched(*In<QTableView>(radio, "DataList").model()) >= enough; },
        [](QWidget& radio) { Press<QPushButton>(radio, "Stop"); });
    Press<QPushButton>(window, "GetScoresButton");
  });
}

void TakeBox(Studio& studio) {
  struct Box {
    int Type;
    int Team;
    const char* Amount;
  };
  ChoosePort(studio, VenuePort::Box);
  studio.Open("mnuBoxConfig", [&](QWidget& window) {
    auto& results = In<QTableWidget>(window, "Results");
    for (const Box& box : {Box{0, 1, "20"}, Box{0, 2, "20"}, Box{1, 0, "3"}}) {
      const int before = results.rowCount();
      In<QComboBox>(window, "BoxType").setCurrentIndex(box.Type);
      In<QComboBox>(window, "TeamList").setCurrentIndex(box.Team);
      In<QLineEdit>(window, "PointsPerAct").setText(QStringLiteral("5"));
      In<QLineEdit>(window, "RechargePoints").setText(QStringLiteral("10"));
      In<QLineEdit>(window, "ActivationAmount").setText(QString::fromLatin1(box.Amount));
      Press<QPushButton>(window, "ProgramButton");
      studio.WaitUntil("the box answers", [&] { return results.rowCount() > before; });
    }
    studio.Take(window, "box");
  });
}

void TakeButtons(Studio& studio, const Tell& tell) {
  studio.Open("mnuCheckButton", [&](QWidget& window) {
    studio.Take(window, "button");
    Press<QPushButton>(window, "Cancel");
  });
  const std::pair<const char*, const char*> buttons[] = {
      {"5600000001B81C06", "ammo-mag"}, {"0F0000010C915E08", "bandage"}, {"B30000010B423706", "ammo-mag"}};
  studio.Open("mnuChargeiButton", [&](QWidget& window) {
    auto& results = In<QTableWidget>(window, "Results");
    for (const auto& [id, content] : buttons) {
      const int before = results.rowCount();
      tell(QStringLiteral("fill %1 %2").arg(QLatin1String(id), QLatin1String(content)));
      tell(QStringLiteral("touch %1").arg(QLatin1String(id)));
      studio.WaitUntil("the button is charged", [&] { return results.rowCount() > before; });
      studio.Take(window, "charging");  // the last one stays
      tell(QStringLiteral("leave"));
      constexpr int betweenTouches = 1000;  // ms
      QTest::qWait(betweenTouches);
    }
  });
}

void TakeFirmware(Studio& studio, const QDir& props) {
  ChoosePort(studio, VenuePort::Device);
  studio.Open("mnuFirmwareUpdate", [&](QWidget& window) {
    studio.AnswerWith(MakeFirmware(props));
    Press<QPushButton>(window, "cmdBrowse");
    QElapsedTimer time;
    time.start();
    constexpr int underWay = 7000;  // ms
    studio.TakeWhen("FirmwareFlash", "firmware", [&time](QWidget&) { return time.hasExpired(underWay); });
    Press<QPushButton>(window, "cmdDownload");
  });
}

void TakeSounds(Studio& studio, const QDir& props) {
  studio.Open("mnuSoundRecorder", [&](QWidget& window) {
    studio.AnswerWith(MakeSounds(props));
    Press<QPushButton>(window, "OpenList");
    studio.Take(window, "sound-recorder");
  });
}

}  // namespace

void TakeEquipment(Studio& studio, const Tell& tell) {
  const QDir props = QDir::temp();
  TakeRadio(studio);
  TakeBox(studio);
  TakeButtons(studio, tell);
  TakeFirmware(studio, props);
  TakeSounds(studio, props);
}
