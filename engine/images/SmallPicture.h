#pragma once

#include "engine/images/Image.h"
#include "engine/images/ImageFile.h"

namespace quarn {

/// A picture made small enough for a square of so many pixels, with its aspect; one that fits is
/// copied. A pixel is the mean of at most nine that are spread over what it stands for, so that it
/// takes about as long for a picture of any size.
/// @return a picture of no size when there is no picture
Image smallPicture(const ImageView& picture, int most_px);

} // namespace quarn
