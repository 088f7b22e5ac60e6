#include "kelmar/KM_wString.h"

#include "kelmar/KM_CaseFold.h"

#include <algorithm>
#include <utility>

namespace {

std::wstring_view viewOf(const wchar_t* text) {
    return text ? text : std::wstring_view();
}

int sign(int order) {
    return (order > 0) - (order < 0);
}

int indexOf(std::wstring::size_type position) {
    return position == std::wstring::npos ? -1 : static_cast<int>(position);
}

} // namespace

KM_wString::KM_wString(const wchar_t* text) : m_text(viewOf(text)) {}

KM_wString::KM_wString(std::wstring_view text) : m_text(text) {}

int KM_wString::Length() const {
    return static_cast<int>(m_text.size());
}

bool KM_wString::IsEmpty() const {
    return m_text.empty();
}

void KM_wString::Empty() {
    m_text.clear();
}

const wchar_t* KM_wString::Array() const {
    return m_text.c_str();
}

wchar_t KM_wString::operator[](int index) const {
    return index >= 0 && index < Length() ? m_text[static_cast<std::size_t>(index)] : L'\0';
}

void KM_wString::SetAt(int index, wchar_t character) {
    if (index >= 0 && index < Length())
        m_text[static_cast<std::size_t>(index)] = character;
}

KM_wString& KM_wString::operator+=(const KM_wString& tail) {
    m_text += tail.m_text;
    return *this;
}

KM_wString& KM_wString::operator+=(const wchar_t* tail) {
    m_text += viewOf(tail);
    return *this;
}

KM_wString& KM_wString::operator+=(wchar_t tail) {
    m_text += tail;
    return *this;
}

KM_wString operator+(const KM_wString& head, const KM_wString& tail) {
    KM_wString sum(head);
    sum += tail;
    return sum;
}

KM_wString operator+(const KM_wString& head, const wchar_t* tail) {
    KM_wString sum(head);
    sum += tail;
    return sum;
}

KM_wString operator+(const wchar_t* head, const KM_wString& tail) {
    KM_wString sum(head);
    sum += tail;
    return sum;
}

bool operator==(const KM_wString& a, const KM_wString& b) {
    return a.m_text == b.m_text;
}

bool operator==(const KM_wString& a, const wchar_t* b) {
    return a.m_text == viewOf(b);
}

bool operator<(const KM_wString& a, const KM_wString& b) {
    return a.m_text < b.m_text;
}

int KM_wString::Compare(const wchar_t* other) const {
    return sign(m_text.compare(viewOf(other)));
}

int KM_wString::CompareNoCase(const wchar_t* other) const {
    const std::wstring_view text = viewOf(other);
    const std::size_t common = std::min(m_text.size(), text.size());
    for (std::size_t i = 0; i < common; ++i) {
        const wchar_t a = kelmar::foldCase(m_text[i]);
        const wchar_t b = kelmar::foldCase(text[i]);
        if (a != b)
            return a < b ? -1 : 1;
    }
    return (m_text.size() > text.size()) - (m_text.size() < text.size());
}

int KM_wString::Find(wchar_t character) const {
    return indexOf(m_text.find(character));
}

int KM_wString::Find(const wchar_t* text) const {
    return text ? indexOf(m_text.find(text)) : -1;
}

KM_wString KM_wString::Mid(int first, int count) const {
    // In 64 bits, so that first + count cannot overflow.
    const long long begin = std::clamp<long long>(first, 0, Length());
    const long long end =
        std::clamp<long long>(static_cast<long long>(first) + count, begin, Length());
    return KM_wString(
        View().substr(static_cast<std::size_t>(begin), static_cast<std::size_t>(end - begin)));
}

KM_wString KM_wString::Left(int count) const {
    return Mid(0, count);
}

KM_wString KM_wString::Right(int count) const {
    const int kept = std::clamp(count, 0, Length());
    return Mid(Length() - kept, kept);
}

void KM_wString::TrimLeft() {
    m_text.erase(m_text.begin(), std::find_if_not(m_text.begin(), m_text.end(), kelmar::isSpace));
}

void KM_wString::TrimRight() {
    m_text.erase(std::find_if_not(m_text.rbegin(), m_text.rend(), kelmar::isSpace).base(),
                 m_text.end());
}

void KM_wString::TrimLeftAndRight() {
    TrimRight();
    TrimLeft();
}

int KM_wString::Remove(wchar_t character) {
    return static_cast<int>(std::erase(m_text, character));
}

int KM_wString::Replace(wchar_t from, wchar_t to) {
    const auto count = std::count(m_text.begin(), m_text.end(), from);
    std::replace(m_text.begin(), m_text.end(), from, to);
    return static_cast<int>(count);
}

int KM_wString::Replace(const wchar_t* from, const wchar_t* to) {
    const std::wstring_view sought = viewOf(from);
    const std::wstring_view substitute = viewOf(to);
    if (sought.empty())
        return 0;
    std::wstring replaced;
    int count = 0;
    std::size_t done = 0;
    for (std::size_t found = m_text.find(sought); found != std::wstring::npos;
         found = m_text.find(sought, done)) {
        replaced.append(m_text, done, found - done).append(substitute);
        done = found + sought.size();
        ++count;
    }
    if (count > 0)
        m_text = std::move(replaced.append(m_text, done));
    return count;
}

void KM_wString::MakeLower() {
    std::transform(m_text.begin(), m_text.end(), m_text.begin(), kelmar::toLower);
}

void KM_wString::MakeUpper() {
    std::transform(m_text.begin(), m_text.end(), m_text.begin(), kelmar::toUpper);
}
