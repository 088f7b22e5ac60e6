#pragma once

#include "sdk/qncore/QnExport.h"

#include <string>

class CQuarnDoc;

namespace quarn {

/// Where on the earth a document's model stands, how it is turned there, and which clocks it goes
/// by.
struct StudiedSite {
    std::string city;           ///< UTF-8: "Athens, Greece"; empty: no city stands there
    std::string zone;           ///< as Zone::written takes it; empty: that of the nearest city
    double latitude_deg = 0.0;  ///< north positive, -90 to 90
    double longitude_deg = 0.0; ///< east positive, -180 to 180
    double north_deg = 0.0;     ///< clockwise from the model's Y axis
};

/// The place of a document's sun study: of the one that is set up, else the one that the next will
/// begin with.
QNCORE_API StudiedSite studiedSite(CQuarnDoc& document);

/// Keeps a place in the document, so that forms about the sun begin with it. A sun study that is
/// set up keeps its own.
QNCORE_API void keepStudiedSite(CQuarnDoc& document, const StudiedSite& site);

} // namespace quarn
