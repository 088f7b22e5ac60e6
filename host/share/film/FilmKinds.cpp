#include "host/share/film/FilmKinds.h"

#include <algorithm>
#include <cctype>
#include <cmath>
#include <string>

namespace quarn {

namespace {

constexpr const char* ENCODERS = "libavcodec59";

constexpr FilmKindFacts KINDS[] = {
    {FilmKind::mp4, ".mp4", 0, 60, true, true, false, ENCODERS},
    {FilmKind::webm, ".webm", 0, 60, true, true, true, ENCODERS},
    {FilmKind::gif, ".gif", 640, 50, false, true, false, ENCODERS},
    {FilmKind::webp, ".webp", 0, 60, false, true, false, ENCODERS},
    {FilmKind::apng, ".apng", 0, 60, false, false, true, ENCODERS},
};

int evenFrom(int side_px) {
    return side_px + side_px % 2;
}

} // namespace

const FilmKindFacts* filmKindOf(const std::filesystem::path& file) {
    std::string extension = file.extension().native();
    std::ranges::transform(extension, extension.begin(),
                           [](unsigned char character) { return std::tolower(character); });
    const auto* const found =
        std::ranges::find_if(KINDS, [&](const auto& kind) { return extension == kind.extension; });
    return found == std::end(KINDS) ? nullptr : found;
}

FilmSize filmSize(const FilmKindFacts& kind, FilmSize frames, int asked_width_px) {
    const int wanted = asked_width_px > 0 ? asked_width_px : kind.usual_width_px;
    FilmSize film = frames;
    if (wanted > 0 && wanted < frames.width_px) {
        const double share = static_cast<double>(wanted) / frames.width_px;
        film = {wanted, std::max(1, static_cast<int>(std::lround(share * frames.height_px)))};
    }
    return kind.has_even_sides ? FilmSize{evenFrom(film.width_px), evenFrom(film.height_px)} : film;
}

} // namespace quarn
