#pragma once

#include "engine/sunhours/SurfacePoints.h"

#include <span>

class KM_Viewport;

namespace quarn {

/// A place of a picture, in continuous pixels from the upper left corner.
struct PicturePlace {
    float x = 0.0F;
    float y = 0.0F;
};

/// What places of a picture show.
struct PicturePoints {
    SurfacePoints points;              ///< one a place, on the side that is seen
    std::vector<std::uint32_t> object; ///< of each place: an index in DisplayScene::meshes, plus 1;
                                       ///< 0 where no surface is seen
};

/// Finds what is seen at places of a picture, one ray for each. Glass is looked through, see
/// GlassFilter, and so are the backs of one-sided surfaces.
/// @param places  those that follow each other should lie near each other
PicturePoints pointsSeen(const DisplayScene& scene, const KM_Viewport& viewport, int width_px,
                         int height_px, std::span<const PicturePlace> places);

/// The middles of all pixels of a picture, in tiles of four by four whose rays keep together. Of
/// tiles that reach over the border all places are there.
class PixelTiles {
public:
    PixelTiles(int width_px, int height_px);
    std::vector<PicturePlace> places() const;
    /// Where the place of a pixel stands in the list.
    std::size_t indexOf(int x, int y) const;

private:
    std::size_t m_columns;
    std::size_t m_rows;
};

} // namespace quarn
