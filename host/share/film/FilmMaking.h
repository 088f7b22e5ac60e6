#pragma once

#include "ground/PartFile.h"
#include "host/front_end/FrontEnd.h"
#include "host/share/film/FilmWish.h"
#include "host/share/film/FilmWorker.h"

namespace quarn {

/// Makes one film of frames that come one after the other. The file appears whole, at the end, or
/// not at all. Belongs to the main thread.
class FilmMaking {
public:
    struct Plan {
        FilmWish wish;  ///< checked
        int frames = 0; ///< that are to come
        int frame_rate = 0;
        /// That may encode beside what makes the frames; 0: each frame is encoded before the next
        /// is made.
        int threads = 1;
    };
    /// @param front_end  outlives this
    FilmMaking(Plan plan, FrontEnd& front_end);

    /// Takes a frame. Where the encoder is behind, the front end works on its events meanwhile.
    /// @return why there will be no film, in a sentence of the user's language
    Result<void> add(const Image& picture, const std::string& caption);
    /// Waits for the rest, and gives the film its name.
    /// @return what it holds; an error as above, also where there was no frame
    Result<SharedFileReport> finish();

    int framesTaken() const { return m_taken; }

private:
    Result<void> begin(const Image& first);
    Result<void> beginFile();
    void waitForRoom();
    void waitForWorker();
    void waitForEnd();
    Result<SharedFileReport> giveName();
    SharedFileReport report() const;
    void tellPace();
    Error cannotWrite(const std::string& why) const;

    Plan m_plan;
    FrontEnd& m_front_end;
    FilmSize m_frame_size;
    FilmSize m_size;
    std::filesystem::path m_file; ///< behind links
    std::optional<PartFile> m_part;
    std::optional<FilmWorker> m_worker;
    int m_taken = 0;
    bool m_has_told_pace = false;
};

} // namespace quarn
