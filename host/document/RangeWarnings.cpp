#include "host/document/RangeWarnings.h"

#include "host/document/Document.h"
#include "host/document/DocumentList.h"
#include "host/front_end/FrontEnd.h"
#include "sdk/qncore/QnLocalize.h"

#include <vector>

namespace quarn {

namespace {

/// More names than this are counted.
constexpr std::size_t MOST_NAMES = 5;

KM_wString textOf(const std::vector<KM_wString>& names) {
    KM_wString list;
    for (std::size_t i = 0; i < names.size() && i < MOST_NAMES; ++i)
        list += (i > 0 ? L", " : L"") + names[i];
    if (names.size() > MOST_NAMES)
        list = KM_wString::FormatToString(QnLocalizeString(L"%s and %d more", 42521), list.Array(),
                                          static_cast<int>(names.size() - MOST_NAMES));
    return KM_wString::FormatToString(
        QnLocalizeString(L"Not drawn, because it lies beyond 1e12 units or has an extreme scale: "
                         L"%s. It stays in the document. Move or scale it to see it.",
                         42520),
        list.Array());
}

} // namespace

void ObjectRangeWarning::tell(const Document& document, std::span<const KM_UUID> ids) {
    std::vector<KM_wString> names;
    for (const KM_UUID& id : ids) {
        const DocumentObject* object = document.objects().find(id);
        if (!object || !object->visible || !m_told.insert(id).second)
            continue;
        names.push_back(object->name.IsEmpty() ? KM_UuidToString(id) : object->name);
    }
    if (!names.empty())
        document.frontEnd().warn(textOf(names).View());
}

void CameraRangeWarning::tell(const Document& document, bool is_in_range) {
    const DocumentList& list = document.list();
    const bool in_command = list.isCommandRunning();
    if (is_in_range) {
        m_is_told = m_is_told && in_command;
        return;
    }
    const bool is_told = m_is_told && (!in_command || m_told_in == list.commandCount());
    m_is_told = true;
    m_told_in = list.commandCount();
    if (!is_told)
        document.frontEnd().warn(
            QnLocalizeString(L"The camera is out of range: the picture shows the background alone. "
                             L"Move the camera nearer to the origin, with FitView for example.",
                             42522));
}

} // namespace quarn
