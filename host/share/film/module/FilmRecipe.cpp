#include "host/share/film/module/FilmRecipe.h"

#include <algorithm>
#include <cmath>

namespace quarn {

namespace {

constexpr FilmRecipe RECIPES[] = {
    {"libx264", "mp4", AV_PIX_FMT_YUV420P, AV_PIX_FMT_YUV420P, true, false},
    {"libvpx-vp9", "webm", AV_PIX_FMT_YUV420P, AV_PIX_FMT_YUV420P, true, false},
    {"gif", "gif", AV_PIX_FMT_PAL8, AV_PIX_FMT_BGRA, false, false},
    {"libwebp_anim", "webp", AV_PIX_FMT_BGRA, AV_PIX_FMT_BGRA, false, true},
    {"apng", "apng", AV_PIX_FMT_RGB24, AV_PIX_FMT_RGB24, false, false},
};

/// A quality on an encoder's own scale, on which a smaller number is better.
std::string rateFactor(int quality, double at_1, double at_100) {
    return std::to_string(std::lround(at_1 + (at_100 - at_1) * (quality - 1) / 99.0));
}

} // namespace

const FilmRecipe& recipeOf(FilmKind kind) {
    return RECIPES[static_cast<int>(kind)];
}

AvOptions encoderOptions(const FilmForm& form) {
    switch (form.kind) {
    case FilmKind::mp4:
        return {{"preset", "veryfast"}, {"crf", rateFactor(form.quality, 40.0, 12.5)}};
    case FilmKind::webm:
        return {{"b", "0"},
                {"crf", rateFactor(form.quality, 63.0, 22.0)},
                {"deadline", "good"},
                {"cpu-used", "5"},
                {"row-mt", "1"}};
    case FilmKind::webp:
        return {{"quality", std::to_string(50 + form.quality / 2)}, {"compression_level", "2"}};
    case FilmKind::apng:
        return {{"pred", "sub"}};
    case FilmKind::gif:
        break;
    }
    return {};
}

AvOptions containerOptions(const FilmForm& form) {
    switch (form.kind) {
    case FilmKind::mp4:
        return {{"movflags", "+faststart"}};
    case FilmKind::gif: // else a film of one frame shows it for no time
        return {{"loop", "0"},
                {"final_delay", std::to_string(std::lround(100.0 / form.frame_rate))}};
    case FilmKind::webp:
        return {{"loop", "0"}};
    case FilmKind::apng:
        return {{"plays", "0"}};
    case FilmKind::webm:
        break;
    }
    return {};
}

int paletteColours(const FilmForm& form) {
    return std::min(256, 16 + 3 * form.quality);
}

} // namespace quarn
