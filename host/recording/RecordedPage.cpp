#include "host/recording/RecordedPage.h"

#include "ground/FileBytes.h"
#include "host/recording/FrameNames.h"

#include <algorithm>
#include <string_view>

namespace quarn {

namespace {

constexpr std::string_view byte_order_mark = "\xEF\xBB\xBF";
constexpr std::string_view before_title = "<HTML>\n <HEAD>\n  <TITLE>";
constexpr std::string_view after_title = "</TITLE>\n </HEAD>\n <BODY onLoad=\"Load()\">\n";
constexpr std::string_view before_picture = "].src = \"";

/// The file name in a line such as `Images[0].src = "house000.jpg"`; empty for every other line.
std::string_view pictureIn(std::string_view line) {
    const std::size_t begin = line.find(before_picture);
    if (!line.starts_with("Images[") || begin == std::string_view::npos || !line.ends_with('"'))
        return {};
    line.remove_suffix(1);
    return line.substr(std::min(begin + before_picture.size(), line.size()));
}

void addPicture(std::string_view file_name, const std::string& animation,
                PicturesByExtension& pictures) {
    const std::size_t point = file_name.rfind('.');
    if (point == std::string_view::npos)
        return;
    const FrameNames names{animation, std::string(file_name.substr(point + 1))};
    if (const auto frame = names.frameOf(file_name))
        pictures[names.extension].add(*frame);
}

PicturesByExtension picturesIn(std::string_view text, const std::string& animation) {
    PicturesByExtension pictures;
    while (!text.empty()) {
        const std::size_t end = std::min(text.find('\n'), text.size());
        addPicture(pictureIn(text.substr(0, end)), animation, pictures);
        text.remove_prefix(std::min(end + 1, text.size()));
    }
    return pictures;
}

} // namespace

std::optional<PicturesByExtension> picturesOfPage(const std::filesystem::path& page,
                                                  const std::string& animation) {
    std::error_code error;
    if (!std::filesystem::is_regular_file(page, error))
        return std::nullopt;
    const Result<FileBytes> read = readFileBytes(page);
    if (!read)
        return std::nullopt;
    const auto bytes = read.value().bytes();
    const std::string_view text(reinterpret_cast<const char*>(bytes.data()), bytes.size());
    const std::string begin = std::string(byte_order_mark) + std::string(before_title) + animation +
                              std::string(after_title);
    if (!text.starts_with(begin))
        return std::nullopt;
    return picturesIn(text.substr(begin.size()), animation);
}

} // namespace quarn
