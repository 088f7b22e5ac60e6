#pragma once

#include "engine/images/ImageFile.h"

namespace quarn {

/// Whether what lies behind a picture is seen through it anywhere.
bool isSeeThrough(const ImageView& picture);

/// A picture as it is seen on white paper, mixed as browsers and film programs do, in sRGB.
/// @param space  takes the pixels where the picture is see-through
/// @return the picture itself where it is not; else a view of `space`
ImageView onWhite(const ImageView& picture, Image& space);

} // namespace quarn
