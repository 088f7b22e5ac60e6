#include "vexui/texts/LocalText.h"

#include "sdk/qncore/QnLocalize.h"

namespace vexui {

QString localText(const wchar_t* english, int id) {
    return QString::fromWCharArray(QnLocalizeString(english, id));
}

QString toQt(const KM_wString& text) {
    return QString::fromWCharArray(text.Array(), text.Length());
}

KM_wString fromQt(const QString& text) {
    return KM_wString(text.toStdWString().c_str());
}

} // namespace vexui
