#include "app/ConversionWithProgress.h"

#include <QCoreApplication>
#include <QFileInfo>
#include <algorithm>
#include <string>

#include "core/text/Filled.h"

namespace {

/// Takes the window away before a question, which would open behind it.
class StepsWithoutWindow : public ConversionSteps {
 public:
  StepsWithoutWindow(ConversionSteps& steps, std::unique_ptr<QProgressDialog>& window)
      : steps_(steps), window_(window) {}

  bool GoOnWithout(const std::vector<NotTakenOver>& values) override {
    window_.reset();
    return steps_.GoOnWithout(values);
  }
  bool AddInterimRows(std::int64_t rows) override {
    window_.reset();
    return steps_.AddInterimRows(rows);
  }
  bool KeepOn() override { return steps_.KeepOn(); }
  void BeforeReplacing(const OldDatabaseReport& report) override { steps_.BeforeReplacing(report); }

 private:
  ConversionSteps& steps_;
  std::unique_ptr<QProgressDialog>& window_;
};

}  // namespace

ConversionWithProgress::ConversionWithProgress(const StringTable& strings, Files& disk,
                                               std::chrono::milliseconds moment, const std::string& reader)
    : strings_(strings),
      converter_(disk, reader, JetConverter::LongestSilence, [this](std::int64_t rows) { ShowRows(rows); }),
      moment_(moment) {}

OldDatabaseReport ConversionWithProgress::Convert(const OldDatabase& old, ConversionSteps& steps) {
  file_ = QFileInfo(QString::fromStdString(old.Path)).fileName();
  sinceShown_.start();
  isShownElsewhere_ = steps.ShowsProgress();
  const struct Closing {
    std::unique_ptr<QProgressDialog>& Window;
    ~Closing() { Window.reset(); }
  } closing{window_};
  StepsWithoutWindow withoutWindow(steps, window_);
  return converter_.Convert(old, withoutWindow);
}

void ConversionWithProgress::ShowRows(std::int64_t rows) {
  // Most files are done before a window that tells of no rows could be read.
  constexpr std::chrono::milliseconds untilTheFirstRow(1000);
  if (isShownElsewhere_) {
    return;
  }
  const bool isEmpty = rows == 0 && !window_;
  if (sinceShown_.elapsed() < (isEmpty ? std::max(moment_, untilTheFirstRow) : moment_).count()) {
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
