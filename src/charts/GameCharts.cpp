#include "charts/GameCharts.h"

#include <QScrollArea>
#include <QSplitter>
#include <filesystem>

#include "charts/ChartTable.h"
#include "charts/ChartTables.h"
#include "charts/HitMap.h"
#include "charts/PartLook.h"
#include "charts/PictureFile.h"
#include "charts/ScoreChart.h"
#include "core/text/Filled.h"
#include "ui/Announce.h"
#include "ui/Text.h"
#include "ui/WaitCursor.h"
#include "ui_GameCharts.h"

GameCharts::GameCharts(const Parts& parts)
    : parts_(parts),
      ui_(std::make_unique<Ui::GameCharts>()),
      hitRows_(new HitRows(parts.Strings, this)),
      scoreRows_(new ScoreRows(parts.Strings, this)),
      commands_(*this, parts.Boxes) {
  ui_->setupUi(this);
  setWindowFlags(Qt::Window);
  setAttribute(Qt::WA_QuitOnClose, false);
  ui_->HitTable->setModel(hitRows_);
  ui_->ScoreTable->setModel(scoreRows_);
  ui_->Map->SetUp(parts.Strings);
  ui_->Bars->SetUp(parts.Strings);
  constexpr int lines = 2;
  ui_->TellLabel->setMinimumHeight(lines * fontMetrics().lineSpacing());
  constexpr int chart = 8;
  constexpr int table = 5;
  for (QSplitter* splitter : {ui_->HitsSplitter, ui_->ScoresSplitter}) {
    splitter->setSizes({chart * width(), table * width()});  // shares of what there is
  }
  SetTexts();
  ConnectCharts();
  commands_.Connect(*this, {{ui_->SavePicture, &GameCharts::SavePicture}});
  commands_.EscapePresses(*ui_->Close);
  connect(ui_->Close, &QPushButton::clicked, this, &QWidget::close);
}

GameCharts::~GameCharts() = default;

void GameCharts::SetTexts() {
  const auto text = [this](OwnText which) { return Text(parts_.Strings, which); };
  setWindowTitle(text(OwnText::GameCharts));
  ui_->Charts->setTabText(0, text(OwnText::WhoHitWhom));
  ui_->Charts->setTabText(1, text(OwnText::ScoreOrigins));
  ui_->EmptyLabel->setText(text(OwnText::NothingToChart));
  ui_->SavePicture->setText(text(OwnText::SavePicture));
  ui_->HitTable->setAccessibleName(text(OwnText::WhoHitWhom));
  ui_->ScoreTable->setAccessibleName(text(OwnText::ScoreOrigins));
  constexpr int close = 137;
  ui_->Close->setText(Text(parts_.Strings, close));
}

void GameCharts::ConnectCharts() {
  connect(ui_->Map, &HitMap::Told, this, [this](const QString& text, bool chosen) {
    Tell(text, chosen);
    if (const auto row = hitRows_->RowOf(*ui_->Map->Cell()); chosen && row) {
      ui_->HitTable->GoTo(*row);
    }
  });
  connect(ui_->HitTable, &ChartTable::RowReached, this, [this](int row) {
    const HitCell cell = hitRows_->CellOf(row);
    ui_->Map->SetCell(cell);
    Tell(ui_->Map->TextOf(cell), false);
  });
  connect(ui_->Bars, &ScoreChart::Told, this, [this](const QString& text, bool chosen) {
    Tell(text, chosen);
    if (chosen) {
      ui_->ScoreTable->GoTo(*ui_->Bars->Place());
    }
  });
  const auto reach = [this](const QRect& row) {
    ui_->BarsScroll->ensureVisible(0, row.center().y(), 0, row.height());
  };
  connect(ui_->Bars, &ScoreChart::Reached, this, reach);
  connect(ui_->ScoreTable, &ChartTable::RowReached, this, [this, reach](int row) {
    ui_->Bars->SetPlace(row);
    reach(ui_->Bars->RowOf(row));
    Tell(ui_->Bars->TextOf(row), false);
  });
  connect(ui_->Charts, &QTabWidget::currentChanged, this, &GameCharts::TellAgain);
}

void GameCharts::ShowGame(const ChartGame& game) {
  title_ = game.Title;
  fileName_ = game.FileName;
  ui_->TitleLabel->setText(QString::fromStdString(title_));
  ui_->Map->SetMatrix(HitMatrix(game));
  ui_->Bars->SetPlayers(ScorePartsOf(game));
  hitRows_->Show(ui_->Map->Matrix());
  scoreRows_->Show(ui_->Bars->Players());
  ui_->HitTable->FitColumns();
  ui_->ScoreTable->FitColumns();
  ui_->Legend->SetParts(PartsInUse(ui_->Bars->Players()), parts_.Strings);
  const bool isEmpty = game.Players.empty();
  ui_->EmptyLabel->setVisible(isEmpty);
  ui_->TitleLabel->setVisible(!isEmpty);
  ui_->Charts->setVisible(!isEmpty);
  ui_->TellLabel->setVisible(!isEmpty);
  ui_->SavePicture->setEnabled(!isEmpty);
  TellAgain();
}

void GameCharts::TellAgain() {
  QString text;
  if (ShowsHits() && ui_->Map->Cell()) {
    text = ui_->Map->TextOf(*ui_->Map->Cell());
  } else if (!ShowsHits() && ui_->Bars->Place()) {
    text = ui_->Bars->TextOf(*ui_->Bars->Place());
  }
  Tell(text, false);
}

bool GameCharts::ShowsHits() const {
  return ui_->Charts->currentIndex() == 0;
}

void GameCharts::Tell(const QString& text, bool aloud) {
  ui_->TellLabel->setText(text);
  if (aloud) {
    Announce(*ui_->TellLabel);
  }
}

std::string GameCharts::AskForFile() {
  const std::string chart = parts_.Strings.Text(ShowsHits() ? OwnText::WhoHitWhom : OwnText::ScoreOrigins);
  const auto chosen =
      parts_.CommonDialog1.ShowSave({.Filter = parts_.Strings.Text(OwnText::PngPictures) + " (*.png)|*.png",
                                     .Name = (fileName_.empty() ? chart : fileName_ + " " + chart) + ".png",
                                     .Folder = folder_});
  if (!chosen) {
    return {};
  }
  const std::filesystem::path path(*chosen);
  folder_ = path.parent_path().string();
  const bool writes =
      !parts_.Disk.FileExists(*chosen) ||
      parts_.Boxes.Show(Filled(parts_.Strings.Text(OwnText::ReplacePicture), {path.filename().string()}),
                        windowTitle().toStdString(), BoxIcon::Question,
                        BoxButtons::OkCancel) == BoxAnswer::Ok;
  return writes ? *chosen : std::string();
}

void GameCharts::SavePicture() {
  try {
    const std::string file = AskForFile();
    if (file.empty()) {
      return;
    }
    const WaitCursor cursor;
    const QString title = QString::fromStdString(title_);
    const QImage picture = ShowsHits() ? ui_->Map->Picture(title) : ui_->Bars->Picture(title);
    parts_.Disk.Replace(file, PngOf(picture, parts_.Strings));
    Tell(QString::fromStdString(Filled(parts_.Strings.Text(OwnText::PictureSaved), {file})), true);
  } catch (const RuntimeError& error) {
    parts_.Boxes.Show(Filled(parts_.Strings.Text(OwnText::PictureNotSaved), {error.what()}),
                      windowTitle().toStdString(), BoxIcon::Exclamation);
  }
}

void GameCharts::reject() {
  if (commands_.MayClose()) {
    QDialog::reject();
  }
}
