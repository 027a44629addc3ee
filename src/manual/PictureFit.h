#pragma once

#include <QString>

class QTextBrowser;

/// Gives the page's document its pictures from `folder`, as sharp as the screen allows. Those wider than the
/// page become smaller, so that nobody has to scroll sideways. To be called again after a change of width.
void FitPictures(QTextBrowser& page, const QString& folder);
