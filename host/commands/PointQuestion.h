#pragma once

#include "host/prompt/PromptState.h"

namespace quarn {

/// A question whose text is a point, written x,y,z: a window takes a click in a view for one.
/// @tparam Get  CQuarnGetOption or CQuarnGetString
template <class Get> class PointQuestion : public Get {
public:
    PointQuestion() { this->m_state->takes_points = true; }
};

} // namespace quarn
