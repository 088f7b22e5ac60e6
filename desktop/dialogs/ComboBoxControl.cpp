#include "desktop/dialogs/ComboBoxControl.h"

#include "desktop/texts/Texts.h"

namespace quarn::desktop {

void ComboBoxControl::Reset() {
    if (m_box)
        m_box->clear();
}

int ComboBoxControl::Count() const {
    return m_box ? m_box->count() : 0;
}

/// The box would select the first entry by itself; only Select does.
void ComboBoxControl::Insert(int index, const wchar_t* text) {
    if (!m_box || !text)
        return;
    const bool had_none = m_box->currentIndex() < 0;
    m_box->insertItem(index, qtText(text));
    if (had_none)
        m_box->setCurrentIndex(-1);
}

void ComboBoxControl::Select(int index) {
    if (m_box)
        m_box->setCurrentIndex(index >= 0 && index < m_box->count() ? index : -1);
}

int ComboBoxControl::Selection() const {
    return m_box ? m_box->currentIndex() : -1;
}

} // namespace quarn::desktop
