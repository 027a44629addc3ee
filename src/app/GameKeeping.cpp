#include "app/GameKeeping.h"

#include <QCoreApplication>
#include <utility>

#include "ui/CommandEvent.h"

GameKeeping::GameKeeping(const GameKeeper::Parts& parts, std::function<bool()> pulling,
                         std::function<void(const KeptState& state)> tell)
    : keeper_(parts), pulling_(std::move(pulling)), tell_(std::move(tell)) {
  QCoreApplication::instance()->installEventFilter(this);
}

void GameKeeping::End() {
  QCoreApplication::instance()->removeEventFilter(this);
  keeper_.End();
}

void GameKeeping::Do(void (GameKeeper::*act)()) {
  (keeper_.*act)();
  TellChanges();
}

bool GameKeeping::RemoveDeleted() {
  removing_ = keeper_.RemoveDeleted();
  TellChanges();
  return removing_;
}

bool GameKeeping::CutAPart() {
  const bool hasMore = keeper_.CutAPart();
  TellChanges();
  return hasMore;
}

bool GameKeeping::DoAPart() {
  if (CutAPart() || (removing_ && RemoveDeleted())) {
    return true;
  }
  const bool hasMore = keeper_.CopyAPart();
  TellChanges();
  return hasMore;
}

void GameKeeping::TellChanges() {
  if (keeper_.State() != told_) {
    told_ = keeper_.State();
    tell_(told_);
  }
}

bool GameKeeping::eventFilter(QObject* watched, QEvent* event) {
  if (event->type() == CommandsEndedEvent::EventType() && !pulling_()) {
    Do(&GameKeeper::Keep);
  }
  return QObject::eventFilter(watched, event);
}
