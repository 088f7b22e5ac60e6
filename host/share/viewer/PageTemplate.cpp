#include "host/share/viewer/PageTemplate.h"

#include "ground/FileBytes.h"
#include "ground/PathText.h"

#include <algorithm>
#include <cstdint>

namespace quarn {

namespace {

constexpr std::string_view PLACE_BEGIN = "{{";
constexpr std::string_view PLACE_END = "}}";
constexpr std::string_view FILE_PLACE = "file:";

Result<std::string> readTemplateFile(const std::filesystem::path& file) {
    const Result<FileBytes> bytes = readFileBytes(file);
    if (!bytes)
        return Error{"Cannot read " + textFromPath(file).ToUtf8() + ": " + bytes.message() +
                     ". Install the program with all its files."};
    const auto text = bytes.value().bytes();
    return std::string(reinterpret_cast<const char*>(text.data()), text.size());
}

Result<void> fillPlace(std::string_view name, const std::filesystem::path& folder,
                       const PlaceFillers& fillers, const ByteSink& sink) {
    if (name.starts_with(FILE_PLACE)) {
        const auto text = readTemplateFile(folder / name.substr(FILE_PLACE.size()));
        if (!text)
            return text.error();
        put(sink, text.value());
        return {};
    }
    const auto filler = fillers.find(name);
    if (filler == fillers.end())
        return Error{"The template of the viewer page has an unknown place, {{" +
                     std::string(name) + "}}. Install the program with all its files."};
    filler->second(sink);
    return {};
}

} // namespace

bool put(const ByteSink& sink, std::string_view text) {
    return sink(std::as_bytes(std::span(text)));
}

Result<void> fillTemplate(const std::filesystem::path& file, const PlaceFillers& fillers,
                          const ByteSink& sink) {
    const auto text = readTemplateFile(file);
    if (!text)
        return text.error();
    std::string_view rest = text.value();
    for (;;) {
        const std::size_t begin = rest.find(PLACE_BEGIN);
        const std::size_t end = rest.find(PLACE_END, begin);
        if (!put(sink, rest.substr(0, begin)) || end == rest.npos)
            return {};
        const std::string_view name =
            rest.substr(begin + PLACE_BEGIN.size(), end - begin - PLACE_BEGIN.size());
        if (const auto filled = fillPlace(name, file.parent_path(), fillers, sink); !filled)
            return filled;
        rest.remove_prefix(end + PLACE_END.size());
    }
}

std::string htmlText(std::string_view text) {
    std::string html;
    for (const char c : text) {
        if (c == '&')
            html += "&amp;";
        else if (c == '<')
            html += "&lt;";
        else if (c == '>')
            html += "&gt;";
        else if (c == '"')
            html += "&quot;";
        else
            html += c;
    }
    return html;
}

std::string jsonInHtml(std::string json) {
    for (std::size_t at = json.find('<'); at != json.npos; at = json.find('<', at))
        json.replace(at, 1, "\\u003c");
    return json;
}

std::string addressOf(std::string_view file_name) {
    constexpr std::string_view PLAIN = "abcdefghijklmnopqrstuvwxyzABCDEFGHIJKLMNOPQRSTUVWXYZ"
                                       "0123456789-_.~";
    constexpr std::string_view DIGITS = "0123456789ABCDEF";
    std::string address;
    for (const char c : file_name) {
        const auto byte = static_cast<unsigned char>(c);
        if (PLAIN.find(c) != PLAIN.npos)
            address += c;
        else
            address.append({'%', DIGITS[byte / 16], DIGITS[byte % 16]});
    }
    return address;
}

std::string base64(std::span<const std::byte> bytes) {
    constexpr std::string_view DIGITS =
        "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789+/";
    std::string text;
    text.reserve((bytes.size() + 2) / 3 * 4);
    for (; !bytes.empty(); bytes = bytes.subspan(std::min<std::size_t>(3, bytes.size()))) {
        std::uint32_t three = 0;
        for (std::size_t i = 0; i < 3; ++i)
            three = three << 8 | (i < bytes.size() ? std::to_integer<std::uint32_t>(bytes[i]) : 0);
        for (std::size_t i = 0; i < 4; ++i)
            text += i <= bytes.size() ? DIGITS[three >> (18 - 6 * i) & 63] : '=';
    }
    return text;
}

} // namespace quarn
