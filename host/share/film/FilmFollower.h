#pragma once

#include "host/clock/Zone.h"
#include "host/recording/RecordingFollower.h"
#include "host/share/film/FilmMaking.h"
#include "kelmar/KM_AnimationProperties.h"

#include <optional>
#include <tbb/global_control.h>

namespace quarn {

class Application;

/// Makes a film of a recording while it is made, of the frames as they are shown.
class FilmFollower final : public RecordingFollower {
public:
    /// @param wish         checked
    /// @param application  outlives this
    FilmFollower(FilmWish wish, Application& application);

    void frameRecorded(const RecordedFrame& frame) override;
    void frameKept(int number, const std::filesystem::path& file) override;
    void recordingEnded(const RecordingReport& report) override;

private:
    void begin();
    int threadsBesideDrawing();
    Result<void> take(int number, const Image& picture);
    void end(const Result<SharedFileReport>& made);

    FilmWish m_wish;
    Application& m_application;
    std::optional<Zone> m_zone;                         ///< of a sun study
    KM_3dmAnimationProperties m_record;                 ///< of the animation, once a frame came
    std::optional<tbb::global_control> m_drawing_limit; ///< what drawing leaves is the encoder's
    std::optional<FilmMaking> m_making;
    bool m_has_ended = false; ///< told
};

} // namespace quarn
