#include "demo/PageReader.h"

#include <QNetworkReply>
#include <QRegularExpression>
#include <QTest>
#include <memory>

namespace {

QList<QUrl> LinksIn(const QByteArray& page, const QUrl& address) {
  static const QRegularExpression link(QStringLiteral("(?:href|src)=\"?([^\" >]+)"));
  QList<QUrl> links;
  for (auto match = link.globalMatch(QString::fromUtf8(page)); match.hasNext();) {
    links.append(address.resolved(QUrl(match.next().captured(1))));
  }
  return links;
}

}  // namespace

std::map<QString, QByteArray> PageReader::ReadFrom(const QUrl& start) {
  std::map<QString, QByteArray> pages;
  QList<QUrl> due{start};
  while (!due.isEmpty()) {
    const QUrl address = due.takeFirst();
    if (pages.contains(address.path()) || missing_.contains(address.path())) {
      continue;
    }
    const std::optional<QByteArray> page = Read(address);
    if (page) {
      pages[address.path()] = *page;
      due += LinksIn(*page, address);
    } else {
      missing_.append(address.path());
    }
  }
  return pages;
}

std::optional<QByteArray> PageReader::Read(const QUrl& address) {
  constexpr int limit = 20'000;
  constexpr int found = 200;
  const std::unique_ptr<QNetworkReply> reply(network_.get(QNetworkRequest(address)));
  const bool isThere = QTest::qWaitFor([&reply] { return reply->isFinished(); }, limit) &&
                       reply->attribute(QNetworkRequest::HttpStatusCodeAttribute).toInt() == found;
  return isThere ? std::optional(reply->readAll()) : std::nullopt;
}
