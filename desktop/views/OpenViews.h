#pragma once

#include "host/session/Session.h"
#include "sdk/qncore/QnView.h"

#include <QString>
#include <QStringList>

namespace quarn::desktop {

/// The names of a document's views, in their order.
QStringList viewNames(CQuarnDoc& document);

/// The view with this name; null when there is none. Valid until a command ends: look it up anew
/// each time.
CQuarnView* findView(CQuarnDoc& document, const QString& name);

/// The name of the view that is worked in.
QString activeViewName(CQuarnDoc& document);

} // namespace quarn::desktop
