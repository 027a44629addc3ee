#pragma once

#include <QNetworkAccessManager>
#include <QUrl>
#include <map>
#include <optional>

/// Reads pages as a phone does that follows every link.
class PageReader {
 public:
  /// All pages that links lead to from `start`, by path, as they were served. Those that are not there are
  /// named in `Missing`.
  std::map<QString, QByteArray> ReadFrom(const QUrl& start);

  const QStringList& Missing() const { return missing_; }

 private:
  /// None for anything but a page.
  std::optional<QByteArray> Read(const QUrl& address);

  QNetworkAccessManager network_;
  QStringList missing_;
};
