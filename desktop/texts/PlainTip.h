#pragma once

#include <QString>
#include <QTextDocument>

namespace quarn::desktop {

/// A tool tip that shows the text as it is: Qt takes one that looks like HTML for HTML.
inline QString plainTip(const QString& text) {
    return Qt::mightBeRichText(text) ? Qt::convertFromPlainText(text, Qt::WhiteSpaceNormal) : text;
}

} // namespace quarn::desktop
