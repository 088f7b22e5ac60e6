#pragma once

#include "quarn/arguments/OptionAdder.h"
#include "quarn/scripts/LightScript.h"

#include <optional>
#include <string>

namespace quarn::program {

/// Adds what tells how pictures are lit, and what a model stands before and on.
void addLight(const OptionAdder& add, LightRequest& light);

/// Why pictures of a kind cannot be made with this light: a sentence, or nothing.
/// @param format  "jpg", as --format or the ending of a file has it
std::optional<std::string> whyLightIsMisused(const LightRequest& light, const std::string& format);

} // namespace quarn::program
