#include "devices/radio/RemoteManage.h"

#include <QEvent>
#include <QHeaderView>
#include <QScopeGuard>
#include <QScrollBar>
#include <QtMath>
#include <algorithm>
#include <initializer_list>

#include "core/text/Filled.h"
#include "core/text/NumberForms.h"
#include "devices/radio/GunListModel.h"
#include "devices/radio/GunSearch.h"
#include "devices/radio/RadioLink.h"
#include "devices/radio/ScoreFetch.h"
#include "ui/Announce.h"
#include "ui/Text.h"
#include "ui/WaitCursor.h"
#include "ui_RemoteManage.h"

namespace {

constexpr std::int16_t FewestIds = 128;
constexpr std::int16_t MostIds = 224;

constexpr double LastColumns = 5.1;  ///< of the last column's width in the list's; leaves room for the frame

/// Sizes of the list's letters, relative to the window's.
constexpr double LargestLetters = 1.25;
constexpr double SmallestLetters = 0.9;
constexpr double LettersStep = 0.05;

/// Pixels that the widest text of the list needs, with its sign and the cell's margins.
int WidestColumn(const QFont& letters) {
  constexpr int signAndMargins = 32;
  return QFontMetrics(letters).horizontalAdvance(
             QString::fromStdString(StatusText(ScoreStatus::InProgress))) +
         signAndMargins;
}

}  // namespace

RemoteManage::RemoteManage(const Parts& parts, QWidget* parent)
    : QDialog(parent),
      ui_(std::make_unique<Ui::RemoteManage>()),
      parts_(parts),
      maxPlayerId_(FewestIds),
      commands_(*this, parts.Boxes) {
  ui_->setupUi(this);
  SetUpList();
  RemoteManage::SetPlayersFound(0);
  ui_->Stop->setText(Text(parts_.Strings, OwnText::Stop));
  for (QWidget* progress : std::initializer_list<QWidget*>{ui_->ProgressLabel, ui_->Progress, ui_->Stop}) {
    QSizePolicy place = progress->sizePolicy();
    place.setRetainSizeWhenHidden(true);
    progress->setSizePolicy(place);
  }
  commands_.Connect(*this, {{ui_->SearchGunsButton, &RemoteManage::SearchForGuns},
                            {ui_->GetScoresButton, &RemoteManage::GetScores},
                            {ui_->Stop, &RemoteManage::StopRun}});
  connect(ui_->Close, &QPushButton::clicked, this, &QDialog::reject);
  commands_.EscapePresses(*ui_->Close);
}

RemoteManage::~RemoteManage() = default;

void RemoteManage::SetUpList() {
  list_ = new GunListModel(Text(parts_.Strings, 104), this);
  ui_->DataList->setModel(list_);
  ui_->DataList->setAccessibleName(Text(parts_.Strings, OwnText::GunList));
  ui_->DataList->verticalHeader()->hide();
  ui_->DataList->verticalHeader()->setSectionResizeMode(QHeaderView::Fixed);
  ui_->DataList->horizontalHeader()->setHighlightSections(false);
  ui_->DataList->horizontalHeader()->setMinimumSectionSize(40);
  ui_->DataList->viewport()->installEventFilter(this);
  // Wide enough for the list's largest letters.
  const QMargins margins = layout()->contentsMargins();
  const int around = margins.left() + margins.right() + 2 * ui_->DataList->frameWidth() +
                     ui_->DataList->verticalScrollBar()->sizeHint().width();
  resize(std::max(width(), around + qCeil(WidestColumn(ListFont(LargestLetters)) * LastColumns)), height());
}

QFont RemoteManage::ListFont(double size) const {
  QFont letters = font();
  letters.setPointSizeF(letters.pointSizeF() * size);
  return letters;
}

bool RemoteManage::eventFilter(QObject* watched, QEvent* event) {
  if (event->type() == QEvent::Resize) {
    ShareListWidth();
  }
  return QDialog::eventFilter(watched, event);
}

void RemoteManage::ShareListWidth() {
  constexpr int columns = 5;
  const int width = ui_->DataList->viewport()->width();
  const int lastWidth = static_cast<int>(width / LastColumns);
  for (int column = 0; column < columns - 1; ++column) {
    ui_->DataList->setColumnWidth(column, width / columns);
  }
  ui_->DataList->setColumnWidth(columns - 1, lastWidth);
  FitLetters(lastWidth);
}

void RemoteManage::FitLetters(int columnWidth) {
  double size = LargestLetters;
  while (size > SmallestLetters && WidestColumn(ListFont(size)) > columnWidth) {
    size -= LettersStep;
  }
  const QFont letters = ListFont(size);
  ui_->DataList->setFont(letters);
  ui_->DataList->verticalHeader()->setDefaultSectionSize(QFontMetrics(letters).height() + 10);
}

void RemoteManage::SearchForGuns() {
  maxPlayerId_ = ui_->Guns128->isChecked() ? FewestIds : MostIds;
  const int run = latestRun_ + 1;
  Work([this](RadioLink& link) {
    GunSearch(link, parts_.Events, parts_.Strings, guns_, *this).SearchGuns(maxPlayerId_);
  });
  if (run != latestRun_) {
    return;
  }
  if (IsStopped(run)) {
    ShowHint(Filled(parts_.Strings.Text(OwnText::SearchStopped), {std::to_string(GunsPresent())}));
  } else if (AnsweredUpToEdge(guns_, maxPlayerId_)) {
    ShowHint(parts_.Strings.Text(OwnText::GunsAtEdge));
  }
}

void RemoteManage::GetScores() {
  const int run = latestRun_ + 1;
  fetchRun_ = run;
  const auto ended = qScopeGuard([this] {
    if (parts_.FetchEnded) {
      parts_.FetchEnded();
    }
  });
  Work([this](RadioLink& link) {
    ScoreFetch(link, parts_.Events, parts_.Time, parts_.Strings, parts_.Game, guns_, *this, parts_.BeforeGun)
        .GetScores();
  });
  if (run == latestRun_ && IsStopped(run)) {
    SetStatus("Idle");
    ShowHint(Filled(parts_.Strings.Text(OwnText::FetchStopped),
                    {std::to_string(GunsFetched()), std::to_string(GunsPresent())}));
  }
}

void RemoteManage::StopRun() {
  stoppedRun_ = latestRun_;
}

int RemoteManage::GunsPresent() const {
  return static_cast<int>(
      std::count_if(guns_.begin(), guns_.end(), [](const GunEntry& gun) { return gun.Present; }));
}

int RemoteManage::GunsFetched() const {
  return static_cast<int>(std::count_if(guns_.begin(), guns_.end(), [](const GunEntry& gun) {
    return gun.Present && gun.ScoreStatus == ScoreStatus::Ok;
  }));
}

void RemoteManage::Work(const std::function<void(RadioLink&)>& job) {
  const WaitCursor cursor;
  const int run = ++latestRun_;
  ShowHint({});
  RadioLink link(parts_.MSComm1, parts_.Port, parts_.Events,
                 [this, run] { return commands_.CloseRequested() || run != latestRun_ || IsStopped(run); });
  try {
    job(link);
  } catch (const RuntimeError&) {
    SetStatus("Idle");
    throw;
  }
  link.ThrowIfLineLost();
}

void RemoteManage::reject() {
  if (commands_.MayClose()) {
    QDialog::reject();
  }
}

void RemoteManage::SetStatus(const std::string& text) {
  ui_->StatusLabel->setText(QString::fromStdString(text));
  const bool running = commands_.Running() && text.ends_with("...");
  ui_->ProgressLabel->setVisible(running);
  ui_->Progress->setVisible(running);
  ui_->Stop->setVisible(running);
}

void RemoteManage::ShowHint(const std::string& text) {
  ui_->Hint->setText(QString::fromStdString(text));
  ui_->Hint->setVisible(!text.empty());
  if (!text.empty()) {
    Announce(*ui_->Hint);
  }
}

void RemoteManage::SetPlayersFound(int count) {
  ui_->PlayerCountLabel->setText(QString::fromStdString(Str(count)));
}

void RemoteManage::ClearGunList() {
  list_->Clear();
}

void RemoteManage::RefreshGunList() {
  list_->Show(guns_, maxPlayerId_);
  if (latestRun_ == fetchRun_ && parts_.Fetching) {
    parts_.Fetching(GunsFetched(), GunsPresent());
  }
  parts_.Events.DoEvents();
}

void RemoteManage::SetProgress(const std::string& text, int step, int steps) {
  ui_->ProgressLabel->setText(QString::fromStdString(text));
  ui_->Progress->setMaximum(steps);
  ui_->Progress->setValue(step);
}
