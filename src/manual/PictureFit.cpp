#include "manual/PictureFit.h"

#include <QPixmap>
#include <QStringList>
#include <QTextBlock>
#include <QTextBrowser>
#include <QUrl>

namespace {

QStringList PicturesIn(const QTextDocument& document) {
  QStringList names;
  for (QTextBlock block = document.begin(); block.isValid(); block = block.next()) {
    for (auto part = block.begin(); !part.atEnd(); ++part) {
      const QTextCharFormat format = part.fragment().charFormat();
      if (format.isImageFormat()) {
        names.append(format.toImageFormat().name());
      }
    }
  }
  return names;
}

}  // namespace

void FitPictures(QTextBrowser& page, const QString& folder) {
  QTextDocument& document = *page.document();
  const qreal scale = page.devicePixelRatioF();
  const int room = page.viewport()->width() - 2 * qRound(document.documentMargin());
  for (const QString& name : PicturesIn(document)) {
    QPixmap picture(folder + name);
    if (picture.width() > room && room > 0) {
      picture = picture.scaledToWidth(qRound(room * scale), Qt::SmoothTransformation);
      picture.setDevicePixelRatio(scale);
    }
    document.addResource(QTextDocument::ImageResource, QUrl(name), picture);
  }
  document.markContentsDirty(0, document.characterCount());
}
