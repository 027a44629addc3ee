#include "app/ConversionWithProgress.h"

#include <QCoreApplication>
#include <QFileInfo>
#include <string>

#include "core/text/Filled.h"

ConversionWithProgress::ConversionWithProgress(const StringTable& strings, std::chrono::milliseconds moment,
                                               const std::string& reader)
    : strings_(strings),
      converter_(reader, JetConverter::LongestSilence, [this](std::int64_t rows) { ShowRows(rows); }),
      moment_(moment) {}

OldDatabaseReport ConversionWithProgress::Convert(const std::string& path, const std::string& table,
                                                  const std::string& emptyDatabase) {
  file_ = QFileInfo(QString::fromStdString(path)).fileName();
  sinceShown_.start();
  const struct Closing {
    std::unique_ptr<QProgressDialog>& Window;
    ~Closing() { Window.reset(); }
  } closing{window_};
  return converter_.Convert(path, table, emptyDatabase);
}

void ConversionWithProgress::ShowRows(std::int64_t rows) {
  if (sinceShown_.elapsed() < moment_.count()) {
    return;
  }
  sinceShown_.start();
  if (!window_) {
    window_ = std::make_unique<QProgressDialog>();
    window_->setWindowTitle(QStringLiteral("Tessarine"));
    window_->setCancelButton(nullptr);
    window_->setRange(0, 0);
    window_->setMinimumWidth(window_->fontMetrics().averageCharWidth() * 60);
    window_->show();
  }
  window_->setLabelText(QString::fromStdString(
      Filled(strings_.Text(OwnText::ConvertingOldDatabase), {file_.toStdString(), std::to_string(rows)})));
  QCoreApplication::processEvents(QEventLoop::ExcludeUserInputEvents);
}
