#include "manual/ManualWindow.h"

#include <QFile>
#include <QGuiApplication>
#include <QKeyEvent>
#include <QTimer>
#include <QWindow>

#include "manual/PictureFit.h"
#include "ui/DialogParent.h"
#include "ui/Text.h"
#include "ui_ManualWindow.h"

namespace {

std::vector<ManualPage> ReadPages(const QString& folder, Language language) {
  QFile file(folder + (language == Language::SimplifiedChinese ? QStringLiteral("manual.zh.md")
                                                               : QStringLiteral("manual.md")));
  return file.open(QIODevice::ReadOnly) ? ManualPages(file.readAll().toStdString())
                                        : std::vector<ManualPage>();
}

}  // namespace

ManualWindow::ManualWindow(const StringTable& strings, const QString& folder)
    : ui_(std::make_unique<Ui::ManualWindow>()),
      folder_(folder + u'/'),
      pages_(ReadPages(folder_, strings.TextLanguage())) {
  ui_->setupUi(this);
  setWindowTitle(Text(strings, OwnText::ManualTitle));
  ui_->Pages->setAccessibleName(Text(strings, OwnText::ManualPages));
  ui_->Page->setAccessibleName(windowTitle());
  setAttribute(Qt::WA_QuitOnClose, false);
  setProperty(DialogParent::StandsBeside, true);
  for (const ManualPage& page : pages_) {
    ui_->Pages->addItem(QString::fromStdString(page.Title));
  }
  connect(ui_->Pages, &QListWidget::currentRowChanged, this, &ManualWindow::ShowPage);
  connect(ui_->Page, &QTextBrowser::anchorClicked, this, &ManualWindow::FollowLink);
  ui_->Page->viewport()->installEventFilter(this);
  winId();
  windowHandle()->installEventFilter(this);
}

ManualWindow::~ManualWindow() = default;

void ManualWindow::ShowPageOf(const QWidget& window) {
  std::size_t page = 0;
  for (const QWidget* each = &window; each != nullptr; each = each->parentWidget()) {
    if (const auto found = PageOfWindow(each->objectName().toStdString(), pages_)) {
      page = *found;
      break;
    }
  }
  ShowInFront(page);
}

void ManualWindow::ShowPageTitled(const QString& title) {
  ShowInFront(PageOfLink('#' + AnchorOf(title.toStdString()), pages_).value_or(0));
}

void ManualWindow::ShowInFront(std::size_t page) {
  ui_->Pages->setCurrentRow(static_cast<int>(page));
  BelongToModalWindow();
  show();
  raise();
  activateWindow();
  ui_->Page->setFocus();
}

void ManualWindow::ShowPage(int page) {
  if (page >= 0) {
    ui_->Page->setMarkdown(QString::fromStdString(pages_.at(static_cast<std::size_t>(page)).Text));
    FitPictures(*ui_->Page, folder_);
  }
}

void ManualWindow::FollowLink(const QUrl& link) {
  if (const auto page = PageOfLink('#' + link.fragment(QUrl::FullyDecoded).toStdString(), pages_)) {
    ui_->Pages->setCurrentRow(static_cast<int>(*page));
  }
}

void ManualWindow::BelongToModalWindow() {
  if (QWindow* modal = QGuiApplication::modalWindow(); modal != windowHandle()) {
    windowHandle()->setTransientParent(modal);
  }
}

bool ManualWindow::eventFilter(QObject* watched, QEvent* event) {
  if (event->type() == QEvent::Resize && watched == ui_->Page->viewport()) {
    // Not while the page is laid out for its new width. That the scroll bar is always there keeps the new
    // height of the pictures from changing the width once more.
    QTimer::singleShot(0, this, [this] { FitPictures(*ui_->Page, folder_); });
  }
  if (event->type() == QEvent::WindowBlocked || event->type() == QEvent::WindowUnblocked) {
    // The toolkit is just telling all windows.
    QTimer::singleShot(0, this, &ManualWindow::BelongToModalWindow);
  }
  return QWidget::eventFilter(watched, event);
}

void ManualWindow::keyPressEvent(QKeyEvent* event) {
  if (event->matches(QKeySequence::Cancel)) {
    close();
  } else {
    QWidget::keyPressEvent(event);
  }
}
