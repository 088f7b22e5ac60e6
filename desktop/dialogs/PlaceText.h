#pragma once

#include "host/cities/Cities.h"
#include "host/front_end/FrontEndChoices.h"

#include <QString>

namespace quarn::desktop {

/// A place in the user's language: "48.14° N, 11.58° E".
QString placeText(const Place& place);

/// A city with its country: "Munich, Germany".
QString cityText(const City& city);

} // namespace quarn::desktop
