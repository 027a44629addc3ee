#include <QDir>

#include "tests/members/MembersWindow.h"

namespace {

TEST_F(MembersWindow, Grab) {
  QImage image(640, 800, QImage::Format_RGB32);
  for (int y = 0; y < 800; ++y)
    for (int x = 0; x < 640; ++x) image.setPixelColor(x, y, QColor(x % 256, y % 256, (x * y) % 200));
  QByteArray bytes;
  QBuffer buffer(&bytes);
  image.save(&buffer, "JPG");
  WriteFile(venue.Folder / "p.jpg", bytes.toStdString());
  Sql("UPDATE Members SET TotalGamesPlayed=12, LastPlayedDate='2026-11-20 20:15:00', DallasID='EFCDAB8967452301', TotalDamage=3450, AverageDamage=287.5, TotalSoldiering=12345, AverageSoldiering=1028.75, AveragePrimAccuracy=0.3456 WHERE ContactID IN (1, 9)");
  venue.Dialog.Answers = {venue.Folder / "p.jpg", venue.Folder / "p.jpg"};
  Open([this] {
    Press("ChangePicture");
    QApplication::processEvents();
    window->grab().save(QStringLiteral("/tmp/w/members-en.png"));
    Press("DataLast");
    Line("LastNameEntry").setText(QStringLiteral("عبد الرحمن"));
    window->resize(1024, 735);
    QApplication::processEvents();
    window->grab().save(QStringLiteral("/tmp/w/members-zh.png"));
  });
}

}  // namespace
