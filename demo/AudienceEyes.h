#pragma once

#include <QDir>
#include <QMainWindow>
#include <QObject>
#include <set>

#include "audience/AudienceBoard.h"
#include "demo/Operator.h"
#include "web/ResultsHost.h"

/// What the audience of the demo sees: the board on a screen of its own, of which it takes a picture in each
/// state, and the results page, of which it keeps every page as it is served. Both are switched on already.
class AudienceEyes : public QObject {
  Q_OBJECT

 public:
  AudienceEyes(QMainWindow& window, Operator& faults, const QDir& folder);

  /// Before the game: the board shows the venue, and the page is answered.
  void SeeVenue();

  /// After the game: the board shows its winners and, in its turn, the address; the page has the game.
  void SeeResults();

 private:
  QWidget* Board() const;
  void SavePicture(const QString& name);
  void SeeIncoming();
  bool TurnTo(AudienceView view);
  void KeepPages();
  void RequirePages(const std::map<QString, QByteArray>& pages);

  AudienceBoard& audience_;
  const ResultsHost& results_;
  Operator& faults_;
  QDir folder_;
  bool sawIncoming_ = false;
};
