#include "ground/TextLines.h"

#include "kelmar/KM_wString.h"

#include <fstream>
#include <iterator>

namespace quarn {

Result<std::vector<std::wstring>> readTextLines(const std::filesystem::path& file) {
    std::error_code error;
    if (std::filesystem::is_directory(file, error))
        return Error{file.string() + " is a folder; give the file that is to be read."};
    if (!std::filesystem::is_regular_file(file, error))
        return Error{"There is no file " + file.string() + "."};
    std::ifstream stream(file, std::ios::binary);
    const std::string bytes{std::istreambuf_iterator<char>(stream), {}};
    if (!stream.good() && !stream.eof())
        return Error{"The file " + file.string() + " cannot be read."};

    const KM_wString converted = KM_wString::FromUtf8(bytes);
    std::wstring_view text = converted.View();
    if (text.starts_with(L'\xFEFF'))
        text.remove_prefix(1);
    std::vector<std::wstring> lines;
    while (!text.empty()) {
        const std::size_t end = std::min(text.find(L'\n'), text.size());
        std::wstring_view line = text.substr(0, end);
        if (line.ends_with(L'\r'))
            line.remove_suffix(1);
        lines.emplace_back(line);
        text.remove_prefix(std::min(end + 1, text.size()));
    }
    return lines;
}

} // namespace quarn
