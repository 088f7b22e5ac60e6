#include "host/front_end/FrontEnd.h"

namespace quarn {

FrontEnd::~FrontEnd() = default;

void FrontEnd::pictureRendered(double) {}

} // namespace quarn
