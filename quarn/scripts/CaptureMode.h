#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace quarn::program {

/// What is to be captured: sun studies are drawn in the rendered mode alone.
enum class CaptureSubject { moving_camera, moving_sun };

/// The option that picks a capture mode at the prompt of the set-up commands.
///
/// @param name  a display mode's name, with or without its blanks and hyphens and in any case,
///              or the prompt's own name for it ("RenderedViewport"), or a render method
/// @return the English option as a script writes it ("_RenderedViewport"), or nothing for a name
///         that is no mode's
std::optional<std::string> captureOption(std::string_view name);

/// Whether a sun study that was set up with this option of captureOption() is recorded so.
bool suitsSunStudies(std::string_view option);

/// Whether a capture mode is a render method, whose pictures have a size of their own.
/// @param option  as captureOption gives it
bool isRendered(std::string_view option);

/// The names that captureOption understands, as a person reads them: "Wireframe, Shaded, ...".
std::string captureModeNames(CaptureSubject subject);

} // namespace quarn::program
