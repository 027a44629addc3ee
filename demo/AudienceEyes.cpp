#include "demo/AudienceEyes.h"

#include <QApplication>
#include <QSaveFile>
#include <QTest>

#include "demo/PageReader.h"

namespace {

constexpr int Limit = 20'000;  // ms; far longer than anything takes

/// "/en/g/1/" is the file en/g/1/index.html, "/en/g/1/40" is en/g/1/40.html.
QString FileOfPath(const QString& path) {
  QString file = path.mid(1);
  if (file.isEmpty() || file.endsWith(u'/')) {
    file += QStringLiteral("index");
  }
  return file.contains(u'.') ? file : file + QStringLiteral(".html");
}

}  // namespace

AudienceEyes::AudienceEyes(QMainWindow& window, Operator& faults, const QDir& folder)
    : audience_(*window.findChild<AudienceBoard*>()),
      results_(*window.findChild<ResultsHost*>()),
      faults_(faults),
      folder_(folder) {
  connect(&audience_.Stage(), &AudienceStage::PictureChanged, this, &AudienceEyes::SeeIncoming,
          Qt::QueuedConnection);
}

void AudienceEyes::SeeVenue() {
  constexpr QSize screen(1280, 720);
  if (!QTest::qWaitFor([this] { return Board() != nullptr && Board()->isVisible(); }, Limit)) {
    faults_.AddFault(QStringLiteral("The audience board did not appear."));
    return;
  }
  Board()->resize(screen);
  SavePicture(QStringLiteral("audience-venue.png"));
  if (!QTest::qWaitFor([this] { return !results_.Url().empty(); }, Limit)) {
    faults_.AddFault(QStringLiteral("The results page is not answered."));
  }
}

void AudienceEyes::SeeIncoming() {
  const AudienceState& state = audience_.State();
  const bool isHalf = state.Expected() > 0 && state.Received() >= state.Expected() / 2;
  if (state.View() == AudienceView::Incoming && isHalf && !sawIncoming_) {
    sawIncoming_ = true;
    SavePicture(QStringLiteral("audience-incoming.png"));
  }
}

void AudienceEyes::SeeResults() {
  if (audience_.State().View() == AudienceView::Results) {
    audience_.Stage().Begin();
    SavePicture(QStringLiteral("audience.png"));
    if (TurnTo(AudienceView::Phone)) {
      SavePicture(QStringLiteral("audience-phone.png"));
    }
    audience_.Stage().Begin();
  }
  KeepPages();
}

QWidget* AudienceEyes::Board() const {
  const QWidgetList windows = QApplication::topLevelWidgets();
  const auto found = std::ranges::find_if(
      windows, [](const QWidget* each) { return qobject_cast<const AudienceWindow*>(each) != nullptr; });
  return found != windows.end() ? *found : nullptr;
}

void AudienceEyes::SavePicture(const QString& name) {
  if (QWidget* board = Board()) {
    faults_.SavePicture(*board, name);
  }
}

bool AudienceEyes::TurnTo(AudienceView view) {
  AudienceStage& stage = audience_.Stage();
  for (int turn = 0; turn < stage.Turns(); ++turn) {
    if (stage.Turn().View == view) {
      return true;
    }
    stage.ShowNext();
  }
  return false;
}

void AudienceEyes::KeepPages() {
  PageReader reader;
  const std::map<QString, QByteArray> pages = reader.ReadFrom(QUrl(QString::fromStdString(results_.Url())));
  for (const QString& path : reader.Missing()) {
    faults_.AddFault(QStringLiteral("A link leads to %1, which is not served.").arg(path));
  }
  RequirePages(pages);
  for (const auto& [path, body] : pages) {
    const QString name = folder_.absoluteFilePath(QStringLiteral("pages/") + FileOfPath(path));
    QSaveFile file(name);
    if (!folder_.mkpath(QFileInfo(name).path()) || !file.open(QIODevice::WriteOnly) ||
        file.write(body) != body.size() || !file.commit()) {
      faults_.AddFault(QStringLiteral("%1: %2").arg(name, file.errorString()));
    }
  }
}

void AudienceEyes::RequirePages(const std::map<QString, QByteArray>& pages) {
  QStringList wanted{QStringLiteral("/"), QStringLiteral("/en/games"), QStringLiteral("/zh/games")};
  for (const Standing& player : audience_.State().Results().Players) {
    for (const char* language : {"en", "zh"}) {
      wanted.append(QStringLiteral("/%1/g/1/%2").arg(QLatin1String(language)).arg(player.Index));
    }
  }
  for (const QString& path : wanted) {
    if (!pages.contains(path)) {
      faults_.AddFault(QStringLiteral("No link leads to the page %1.").arg(path));
    }
  }
}
