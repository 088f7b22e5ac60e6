#pragma once

#include "engine/images/ImageFile.h"
#include "host/front_end/ScriptedFrontEnd.h"
#include "host/share/film/FilmMaking.h"
#include "tests/host/share/film/DecodedFilm.h"
#include "tests/support/TempFolder.h"

#include <algorithm>
#include <cmath>

namespace quarn::test {

constexpr int RATE = 20;

/// A picture as scenes have them: soft shades, edges and strong colours, other ones in each frame.
inline Image pictureOf(int width, int height, int frame) {
    Image image;
    image.resize(width, height);
    for (int y = 0; y < height; ++y)
        for (int x = 0; x < width; ++x) {
            std::uint8_t* const pixel =
                image.rgba.data() + 4 * (static_cast<std::size_t>(y) * width + x);
            const double across = static_cast<double>(x) / width;
            const double down = static_cast<double>(y) / height;
            const bool is_wall = std::fabs(across - 0.3 - 0.02 * frame) < 0.15 && down > 0.4;
            pixel[0] = static_cast<std::uint8_t>(is_wall ? 180 : 120 + 60 * down);
            pixel[1] = static_cast<std::uint8_t>(is_wall ? 95 + 30 * across : 150 + 40 * down);
            pixel[2] = static_cast<std::uint8_t>(is_wall ? 75 : 220 - 50 * across);
            pixel[3] = 255;
        }
    return image;
}

/// A folder to make films in.
class FilmStudio {
public:
    /// Makes a film of as many of these pictures.
    Result<SharedFileReport> film(const FilmWish& wish, int frames, int width = 320,
                                  int height = 180, const std::string& caption = {}) {
        FilmMaking making({wish, frames, wish.frame_rate > 0 ? wish.frame_rate : RATE, 2},
                          m_front_end);
        for (int frame = 0; frame < frames; ++frame)
            if (const auto added = making.add(pictureOf(width, height, frame), caption); !added)
                return added.error();
        return making.finish();
    }
    Result<SharedFileReport> film(const std::string& name, int frames, int width = 320,
                                  int height = 180) {
        return film(wish(name), frames, width, height);
    }

    FilmWish wish(const std::string& name) const {
        FilmWish wish;
        wish.file = m_folder / name;
        return wish;
    }

    std::filesystem::path operator/(const std::filesystem::path& name) const {
        return m_folder / name;
    }
    ScriptedFrontEnd& frontEnd() { return m_front_end; }
    /// How many files there are, hidden ones too.
    std::ptrdiff_t fileCount() const {
        return std::distance(std::filesystem::directory_iterator(m_folder.path()), {});
    }

private:
    TempFolder m_folder;
    ScriptedFrontEnd m_front_end;
};

} // namespace quarn::test
