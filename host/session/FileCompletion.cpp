#include "host/session/FileCompletion.h"

#include "kelmar/KM_wString.h"

#include <algorithm>
#include <system_error>

namespace quarn {

namespace {

struct Entry {
    std::wstring name;
    bool is_folder;
};

/// A folder's entries that begin with a text; those that begin with a point only where asked for.
std::vector<Entry> entriesOf(const std::filesystem::path& folder, std::wstring_view start) {
    std::vector<Entry> entries;
    std::error_code error;
    for (std::filesystem::directory_iterator it(folder, error), end; !error && it != end;
         it.increment(error)) {
        const std::wstring name(KM_wString::FromUtf8(it->path().filename().native()).View());
        if (!name.starts_with(start) || (start.empty() && name.starts_with(L'.')))
            continue;
        std::error_code ignored;
        entries.push_back({name, it->is_directory(ignored)});
    }
    std::ranges::sort(entries, {}, &Entry::name);
    return entries;
}

bool hasBlank(const Entry& entry) {
    return entry.name.find_first_of(L" \t") != std::wstring::npos;
}

} // namespace

Completion completeFile(std::wstring_view typed, bool is_word) {
    const bool was_quoted = typed.starts_with(L'"');
    const std::wstring_view path = was_quoted ? typed.substr(1) : typed;
    const std::size_t slash = path.rfind(L'/');
    const std::size_t name_begin = slash == path.npos ? 0 : slash + 1;
    const std::wstring folder(path.substr(0, name_begin));

    const std::string folder_bytes = KM_wString(folder).ToUtf8();
    const std::vector<Entry> entries =
        entriesOf(folder.empty() ? "." : folder_bytes, path.substr(name_begin));
    const bool is_quoted = was_quoted || (is_word && std::ranges::any_of(entries, hasBlank));
    const std::wstring quote = is_quoted ? L"\"" : L"";
    const std::wstring begin = quote + folder;
    const std::wstring end_of_file = is_word ? quote + L" " : quote;
    Completion completion;
    for (const Entry& entry : entries) {
        const std::wstring shown = entry.is_folder ? entry.name + L"/" : entry.name;
        const std::wstring ending = entry.is_folder ? L"" : end_of_file;
        completion.candidates.push_back({begin + shown, shown, ending});
    }
    return completion;
}

} // namespace quarn
