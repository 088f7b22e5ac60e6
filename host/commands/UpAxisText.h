#pragma once

#include "import/ImportedModel.h"

#include <string>

namespace quarn {

/// What a person is told of the axis that was taken as up, where the format leaves it open: "Z is
/// taken as up, as in most files of this kind; the option Up changes that."
/// @return in the person's language, in UTF-8; empty where the format or the person said so
std::string upAxisText(const TakenUpAxis& up);

} // namespace quarn
