#pragma once

#include <filesystem>
#include <optional>
#include <string>

namespace quarn::program {

/// Says why an animation cannot have this name; its pictures and its page are files of that name,
/// and the page finds its pictures by it.
/// @return nothing when it can
std::optional<std::string> whyNameIsRefused(const std::string& name);

/// A name for the animation of a model: the file's without extension, with "_" in place of what a
/// name must not hold, cut where it is too long.
std::string animationNameFor(const std::filesystem::path& model);

} // namespace quarn::program
