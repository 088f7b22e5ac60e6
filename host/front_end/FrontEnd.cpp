#include "host/front_end/FrontEnd.h"

namespace quarn {

FrontEnd::~FrontEnd() = default;

} // namespace quarn
