#pragma once

#include "kelmar/KM_wString.h"
#include "sdk/qncore/QnExport.h"

#include <filesystem>
#include <vector>

class CQuarnDoc;

namespace quarn {

/// What a window shows of the animation of a document.
struct AnimationState {
    bool can_play = false;     ///< an animation is set up, with a camera for each of its frames
    bool is_sun_study = false; ///< the sun moves, not the camera
    int frame_count = 0;       ///< 0 while none can be played
    int current_frame = 0;     ///< shown last, from 0; moved into the frames that there are
    KM_wString name;           ///< of its folder, frame files and page
    KM_wString view;           ///< the name of the view that it is made for
    KM_wString folder;         ///< that recordings go to; empty before the first one
    /// The page that plays a recording in that folder; empty before the first one. Whether it is
    /// there nobody looks.
    std::filesystem::path page_file;
};

/// The animation of a document as it is now. Neither points nor file names are copied, so it may be
/// asked for at every frame. While no plug-in keeps an animation there is none.
QNCORE_API AnimationState animationState(CQuarnDoc& document);

/// When each frame of a sun study is, by the clocks of the place that the document names:
/// "2026-06-21 14:30 CEST"; as the record labels it where it names none. Empty for every other
/// animation.
QNCORE_API std::vector<KM_wString> frameTimes(CQuarnDoc& document);

} // namespace quarn
