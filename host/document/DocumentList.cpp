#include "host/document/DocumentList.h"

#include "sdk/qncore/QnZoetrixDynamicAccess.h"

#include <algorithm>

namespace quarn {

namespace {

DocumentList* current_list = nullptr;

/// Numbers outlive the list, because one that a plug-in kept must never mean another document.
unsigned int nextSerialNumber() {
    static unsigned int last_number = 0;
    return ++last_number;
}

} // namespace

DocumentList::DocumentList(FrontEnd& front_end) : m_front_end(front_end) {
    current_list = this;
}

DocumentList::~DocumentList() {
    closeAll();
    current_list = nullptr;
}

DocumentList* DocumentList::current() {
    return current_list;
}

Document& DocumentList::openNew() {
    m_documents.push_back(std::make_unique<Document>(*this, nextSerialNumber()));
    m_active = m_documents.back().get();
    emptyAnimationRecord(*m_active);
    m_active->markSaved();
    return *m_active;
}

void DocumentList::viewPlaced(ViewState& view) {
    if (m_is_command_running)
        m_placed_view = &view;
}

ViewState& DocumentList::viewToRender(const Document& document) const {
    const bool is_placed = m_placed_view && &m_placed_view->document() == &document;
    return is_placed ? *m_placed_view : document.activeView();
}

void DocumentList::commandEnded() {
    m_is_command_running = false;
    m_placed_view = nullptr;
    m_unsaved_picture.clear();
    closeAllBut(m_active);
    if (m_active)
        m_active->settleViews();
}

void DocumentList::closeAll() {
    m_active = nullptr;
    closeAllBut(nullptr);
}

void DocumentList::closeAllBut(const Document* kept) {
    for (std::unique_ptr<Document>& document : m_documents) {
        if (document.get() == kept)
            continue;
        document->close();
        m_closed_documents.push_back(std::move(document));
    }
    std::erase(m_documents, nullptr);
}

Document* DocumentList::find(unsigned int serial_number) const {
    const auto found = std::find_if(m_documents.begin(), m_documents.end(), [&](const auto& each) {
        return each->serialNumber() == serial_number;
    });
    return found == m_documents.end() ? nullptr : found->get();
}

void DocumentList::rememberFreshRecord() {
    const IQnZoetrixDynamicAccess* const access = Zoetrix_QuarnDynamicAccess();
    if (access == m_fresh_record_access)
        return;
    m_fresh_record_access = access;
    m_fresh_record.reset();
    if (m_active && access)
        m_fresh_record = std::make_unique<KM_3dmAnimationProperties>(
            m_active->properties().AnimationProperties());
    if (m_active)
        m_active->markRecordSaved();
}

void DocumentList::emptyAnimationRecord(Document& document) {
    document.properties().SetAnimationProperties(m_fresh_record ? *m_fresh_record
                                                                : KM_3dmAnimationProperties());
}

} // namespace quarn
