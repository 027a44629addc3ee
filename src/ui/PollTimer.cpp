#include "ui/PollTimer.h"

#include <QApplication>
#include <QWidget>
#include <utility>

#include "ui/Commands.h"

PollTimer::PollTimer(Commands& commands, int milliseconds, std::function<void()> tick)
    : QTimer(&commands.Window()), commands_(commands), tick_(std::move(tick)) {
  setInterval(milliseconds);
  connect(this, &QTimer::timeout, this, &PollTimer::Tick);
}

void PollTimer::Tick() {
  // Boxes and dialogs are modal for the whole application, whichever window they belong to.
  const QWidget* const modal = QApplication::activeModalWidget();
  const bool isCovered = modal != nullptr && modal != &commands_.Window();
  // The toolkit keeps a timer from ticking within its own tick, unless the tick restarts it.
  if (ticking_ || isCovered) {
    return;
  }
  ticking_ = true;
  commands_.Run(tick_);
  ticking_ = false;
}
