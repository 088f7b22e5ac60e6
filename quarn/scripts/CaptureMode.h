#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace quarn::program {

/// What is to be captured: sun studies are drawn in the rendered mode alone.
enum class CaptureSubject { moving_camera, moving_sun };

/// A display mode or a render method, as the prompt of the set-up commands picks it.
struct CaptureMode {
    std::string name;               ///< as a person reads it
    std::string option;             ///< as a script writes it: "_RenderedViewport"
    bool suits_sun_studies = false; ///< whether a study that was set up with it is recorded so
    bool is_rendered = false;       ///< a render method, whose pictures have a size of their own
};

/// Finds a capture mode.
///
/// @param name  a display mode's name, with or without its blanks and hyphens and in any case,
///              or the prompt's own name for it ("RenderedViewport"), or a render method
/// @return nothing for a name that is no mode's
std::optional<CaptureMode> captureMode(std::string_view name);

/// The names of the modes, as a person reads them: "Wireframe, Shaded, ...".
std::string captureModeNames(CaptureSubject subject);

} // namespace quarn::program
