#pragma once

#include "host/front_end/FrontEndChoices.h"

#include <QImage>

namespace quarn::desktop {

/// A copy of a picture, to be painted as it is: what is see-through stands before grey squares.
/// @return a null image where there is no picture, or fewer pixels than its size says
QImage imageOf(const ShownPicture& picture);

} // namespace quarn::desktop
