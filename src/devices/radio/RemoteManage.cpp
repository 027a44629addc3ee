#include "devices/radio/RemoteManage.h"

#include <QEvent>
#include <QHeaderView>

#include "core/text/NumberForms.h"
#include "devices/radio/GunListModel.h"
#include "devices/radio/GunSearch.h"
#include "devices/radio/RadioLink.h"
#include "devices/radio/ScoreFetch.h"
#include "ui/Text.h"
#include "ui/WaitCursor.h"
#include "ui_RemoteManage.h"

namespace {

constexpr std::int16_t FewestIds = 128;
constexpr std::int16_t MostIds = 224;

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
  for (QWidget* progress :
       {static_cast<QWidget*>(ui_->ProgressLabel), static_cast<QWidget*>(ui_->Progress)}) {
    QSizePolicy place = progress->sizePolicy();
    place.setRetainSizeWhenHidden(true);
    progress->setSizePolicy(place);
  }
  commands_.Connect(*this, {{ui_->SearchGunsButton, &RemoteManage::SearchForGuns},
                            {ui_->GetScoresButton, &RemoteManage::GetScores}});
  connect(ui_->Close, &QPushButton::clicked, this, &QDialog::reject);
  commands_.EscapePresses(*ui_->Close);
}

RemoteManage::~RemoteManage() = default;

void RemoteManage::SetUpList() {
  list_ = new GunListModel(Text(parts_.Strings, 104), this);
  QFont figures = ui_->DataList->font();
  figures.setPointSizeF(figures.pointSizeF() * 1.25);
  ui_->DataList->setFont(figures);
  ui_->DataList->setModel(list_);
  ui_->DataList->setAccessibleName(Text(parts_.Strings, OwnText::GunList));
  ui_->DataList->verticalHeader()->hide();
  ui_->DataList->verticalHeader()->setSectionResizeMode(QHeaderView::Fixed);
  ui_->DataList->verticalHeader()->setDefaultSectionSize(QFontMetrics(figures).height() + 10);
  ui_->DataList->horizontalHeader()->setHighlightSections(false);
  ui_->DataList->horizontalHeader()->setMinimumSectionSize(40);
  ui_->DataList->viewport()->installEventFilter(this);
}

bool RemoteManage::eventFilter(QObject* watched, QEvent* event) {
  if (event->type() == QEvent::Resize) {
    ShareListWidth();
  }
  return QDialog::eventFilter(watched, event);
}

void RemoteManage::ShareListWidth() {
  constexpr int columns = 5;
  constexpr double lastColumns = 5.1;  // leaves room for the frame
  const int width = ui_->DataList->viewport()->width();
  for (int column = 0; column < columns - 1; ++column) {
    ui_->DataList->setColumnWidth(column, width / columns);
  }
  ui_->DataList->setColumnWidth(columns - 1, static_cast<int>(width / lastColumns));
}

void RemoteManage::SearchForGuns() {
  maxPlayerId_ = ui_->Guns128->isChecked() ? FewestIds : MostIds;
  Work([this](RadioLink& link) {
    GunSearch(link, parts_.Events, parts_.Strings, guns_, *this).SearchGuns(maxPlayerId_);
  });
}

void RemoteManage::GetScores() {
  Work([this](RadioLink& link) {
    ScoreFetch(link, parts_.Events, parts_.Time, parts_.Strings, parts_.Game, guns_, *this).GetScores();
  });
}

void RemoteManage::Work(const std::function<void(RadioLink&)>& job) {
  const WaitCursor cursor;
  const int run = ++latestRun_;
  RadioLink link(parts_.MSComm1, parts_.Port, parts_.Events,
                 [this, run] { return commands_.CloseRequested() || run != latestRun_; });
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
}

void RemoteManage::SetPlayersFound(int count) {
  ui_->PlayerCountLabel->setText(QString::fromStdString(Str(count)));
}

void RemoteManage::ClearGunList() {
  list_->Clear();
}

void RemoteManage::RefreshGunList() {
  list_->Show(guns_, maxPlayerId_);
  parts_.Events.DoEvents();
}

void RemoteManage::SetProgress(const std::string& text, int step, int steps) {
  ui_->ProgressLabel->setText(QString::fromStdString(text));
  ui_->Progress->setMaximum(steps);
  ui_->Progress->setValue(step);
}
