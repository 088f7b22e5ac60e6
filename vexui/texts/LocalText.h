#pragma once

#include "kelmar/KM_wString.h"

#include <QString>

namespace vexui {

/// A text in the user's language; as QnLocalizeString.
QString localText(const wchar_t* english, int id);

/// Both ways whatever a text holds. Neither result shares memory with this library, which may be
/// unloaded while Qt still keeps a copy.
QString toQt(const KM_wString& text);
KM_wString fromQt(const QString& text);

} // namespace vexui
