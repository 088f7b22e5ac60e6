#include "host/front_end/HeadlessDialogWindow.h"

#include <algorithm>
#include <utility>

namespace quarn {

struct HeadlessDialogWindow::List {
    std::vector<std::wstring> entries;
    int selection = -1;

    bool has(int index) const { return index >= 0 && index < std::ssize(entries); }
};

/// What a CComboBox sees of a list.
class HeadlessDialogWindow::ListControl final : public IQnComboBoxControl {
public:
    explicit ListControl(List& list) : m_list(list) {}

    void Reset() override { m_list = {}; }
    int Count() const override { return static_cast<int>(m_list.entries.size()); }
    void Insert(int index, const wchar_t* text) override {
        const int place = std::clamp(index, 0, Count());
        m_list.entries.insert(m_list.entries.begin() + place, text ? text : L"");
        if (m_list.selection >= place)
            ++m_list.selection;
    }
    void Select(int index) override { m_list.selection = m_list.has(index) ? index : -1; }
    int Selection() const override { return m_list.selection; }

private:
    List& m_list;
};

HeadlessDialogWindow::HeadlessDialogWindow(DialogTemplate form, Script script)
    : m_form(std::move(form)), m_script(std::move(script)) {
    if (!m_form.controls.empty())
        m_focused = m_form.controls.front().id;
    for (const DialogControl& control : m_form.controls) {
        if (control.kind == DialogControl::Kind::combo_box)
            m_lists[control.id] = std::make_unique<List>();
        else if (contentOf(control.id) == Content::date_time)
            m_dates[control.id] = COleDateTime(2000, 1, 1, 0, 0, 0);
    }
}

HeadlessDialogWindow::~HeadlessDialogWindow() = default;

HeadlessDialogWindow::Content HeadlessDialogWindow::contentOf(int control) const {
    using Kind = DialogControl::Kind;
    const auto found = std::ranges::find(m_form.controls, control, &DialogControl::id);
    if (found == m_form.controls.end())
        return Content::none;
    switch (found->kind) {
    case Kind::text:
    case Kind::number:
    case Kind::integer:
        return Content::text;
    case Kind::date:
    case Kind::time:
        return Content::date_time;
    case Kind::combo_box:
        return Content::list;
    case Kind::button:
        return Content::button;
    }
    return Content::none;
}

const HeadlessDialogWindow::List* HeadlessDialogWindow::listOf(int control) const {
    const auto found = m_lists.find(control);
    return found == m_lists.end() ? nullptr : found->second.get();
}

// ---- What a person does

bool HeadlessDialogWindow::type(int control, std::wstring_view text) {
    if (!isOpen() || contentOf(control) != Content::text)
        return false;
    m_focused = control;
    setText(control, text);
    return true;
}

bool HeadlessDialogWindow::choose(int control, const COleDateTime& value) {
    if (!isOpen() || contentOf(control) != Content::date_time || !value.IsValid())
        return false;
    m_focused = control;
    setDateTime(control, value);
    return true;
}

bool HeadlessDialogWindow::pick(int control, int index) {
    const auto found = m_lists.find(control);
    if (!isOpen() || found == m_lists.end() || !found->second->has(index))
        return false;
    m_focused = control;
    found->second->selection = index;
    return true;
}

bool HeadlessDialogWindow::click(int control) {
    if (!isOpen() || contentOf(control) != Content::button)
        return false;
    m_focused = control;
    m_events->buttonClicked(control);
    return true;
}

bool HeadlessDialogWindow::pressOk() {
    if (!isOpen())
        return false;
    m_events->confirmed();
    return true;
}

bool HeadlessDialogWindow::pressCancel() {
    return pressClose();
}

bool HeadlessDialogWindow::pressClose() {
    if (!isOpen())
        return false;
    m_events->givenUp();
    return true;
}

// ---- What a person sees

std::vector<std::wstring> HeadlessDialogWindow::entries(int control) const {
    const List* list = listOf(control);
    return list ? list->entries : std::vector<std::wstring>();
}

int HeadlessDialogWindow::pickedEntry(int control) const {
    const List* list = listOf(control);
    return list ? list->selection : -1;
}

// ---- What the dialog does

void HeadlessDialogWindow::run(DialogEvents& events) {
    m_events = &events;
    if (m_script)
        m_script(*this);
    pressClose();
    m_events = nullptr;
}

void HeadlessDialogWindow::close() {
    m_events = nullptr;
}

bool HeadlessDialogWindow::hasControl(int control) const {
    return contentOf(control) != Content::none;
}

std::wstring HeadlessDialogWindow::text(int control) const {
    const auto found = m_texts.find(control);
    return found == m_texts.end() ? std::wstring() : found->second;
}

void HeadlessDialogWindow::setText(int control, std::wstring_view text) {
    if (contentOf(control) == Content::text)
        m_texts[control] = text;
}

COleDateTime HeadlessDialogWindow::dateTime(int control) const {
    const auto found = m_dates.find(control);
    return found == m_dates.end() ? COleDateTime() : found->second;
}

void HeadlessDialogWindow::setDateTime(int control, const COleDateTime& value) {
    if (contentOf(control) == Content::date_time && value.IsValid())
        m_dates[control] = value;
}

std::unique_ptr<IQnComboBoxControl> HeadlessDialogWindow::comboBox(int control) {
    const auto found = m_lists.find(control);
    return found == m_lists.end() ? nullptr : std::make_unique<ListControl>(*found->second);
}

void HeadlessDialogWindow::focus(int control) {
    if (hasControl(control))
        m_focused = control;
}

} // namespace quarn
