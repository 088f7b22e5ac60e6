#pragma once

#include "ground/Result.h"
#include "host/clock/Zone.h"
#include "host/session/SkyAround.h"
#include "host/sun/SunPosition.h"
#include "sdk/qncore/QnExport.h"

#include <filesystem>
#include <optional>
#include <string>

class CQuarnDoc;

namespace quarn {

/// A sun path diagram that is asked for.
struct SunPathRequest {
    std::string place; ///< UTF-8: "Athens, Greece"; empty: its coordinates alone name it
    SunSite site{};
    Zone zone = Zone::fixed({});
    int year = 0; ///< of those that SunYears.h names
    bool is_stereographic = true;
    bool is_orthographic = false;    ///< beside the other, where both are asked for
    std::optional<double> north_deg; ///< of the model, clockwise from its Y axis, to show it
    std::optional<SkyPoint> point;   ///< to show what the document hides of the sky from there
    std::string model;               ///< UTF-8: what the point is of, "house.glb"
    std::filesystem::path file;      ///< that ends in .svg or .png; one of this name is replaced
};

/// What was drawn.
struct SunPathDrawn {
    std::string clock_name; ///< of the standard time that hours are told in: "CET, UTC+1"
};

/// Draws the ways of the sun over a place through a year, and in grey what the visible surfaces of
/// a document hide of the sky from a point. Takes some tenths of a second.
/// @return an error, sentences: the file cannot be written, or obstructionAround's
QNCORE_API Result<SunPathDrawn> makeSunPath(CQuarnDoc& document, const SunPathRequest& request);

} // namespace quarn
