#pragma once

#include "engine/images/ImageFile.h"
#include "host/recording/RecordedFolder.h"
#include "tests/support/TempFolder.h"

#include <gtest/gtest.h>

namespace quarn::test {

/// A picture of one colour.
inline Image plainPicture(int width, int height, std::uint8_t red) {
    Image image;
    image.resize(width, height);
    for (std::size_t at = 0; at < image.rgba.size(); at += 4) {
        image.rgba[at] = red;
        image.rgba[at + 3] = 255;
    }
    return image;
}

/// A folder with the pictures of an animation, as a recording leaves them.
class RecordedFrames {
public:
    explicit RecordedFrames(int frames, const std::string& extension = "jpg",
                            const std::string& name = "House")
        : m_name(name), m_extension(extension) {
        for (int frame = 0; frame < frames; ++frame)
            write(frame, 64, 36);
    }

    void write(int frame, int width, int height) const {
        const auto written = writeImageFile(
            file(frame), plainPicture(width, height, static_cast<std::uint8_t>(frame)));
        EXPECT_TRUE(written) << written.message();
    }
    std::filesystem::path file(int frame) const {
        const std::string number = std::to_string(frame);
        return m_folder / (m_name + std::string(3 - std::min<std::size_t>(3, number.size()), '0') +
                           number + "." + m_extension);
    }
    void cut(int frame) const {
        std::filesystem::resize_file(file(frame), std::filesystem::file_size(file(frame)) / 2);
    }
    const std::filesystem::path& folder() const { return m_folder.path(); }
    std::filesystem::path page() const { return m_folder / (m_name + "-viewer.html"); }

    RecordedFolder read() const {
        auto recorded = readRecordedFolder(m_folder.path());
        EXPECT_TRUE(recorded) << recorded.message();
        return recorded ? recorded.value() : RecordedFolder{};
    }

private:
    TempFolder m_folder;
    std::string m_name;
    std::string m_extension;
};

} // namespace quarn::test
