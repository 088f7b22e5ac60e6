#pragma once

#include "engine/images/ImageFile.h"
#include "ground/Result.h"

#include <filesystem>
#include <memory>
#include <string>

namespace quarn {

enum class FilmKind { mp4, webm, gif, webp, apng };

/// What a film is to be like.
struct FilmForm {
    FilmKind kind = FilmKind::mp4;
    int width = 0;  ///< pixels; even where the kind needs it
    int height = 0; ///< pixels
    int frame_rate = 0;
    int quality = 0;            ///< 1 to 100
    int threads = 1;            ///< that encode
    std::filesystem::path font; ///< of captions; empty: there are none
};

/// A film that is being written. All but what says otherwise is called by one thread; errors are
/// parts of sentences. No exception leaves it. What was not finished leaves a file that is no film.
class FilmWriter {
public:
    virtual ~FilmWriter() = default;

    /// Appends a frame. A picture that is one pixel narrower or lower than the film has its last
    /// column or row twice; any other size is scaled.
    /// @param picture  all must be of one size; not kept
    /// @param caption  UTF-8, drawn into the lower left corner where the film has a font
    virtual Result<void> add(const ImageView& picture, const std::string& caption) = 0;
    /// Writes the rest; nothing is added after it.
    virtual Result<void> finish() = 0;
    /// How many frames are encoded. Any thread may ask.
    virtual int framesEncoded() const = 0;
    /// Lets finish end soon, with the frames that are encoded by then and at least one. Any thread
    /// may call it.
    virtual void endSoon() = 0;
};

/// What the module that makes films exports, by a function of the type GetFilmModule. It is opened
/// only when a film is to be made, because its libraries are large, and their licence is another
/// one than the program's.
class FilmModule {
public:
    virtual ~FilmModule() = default;
    /// The name of the encoder that films of a kind need and the installed libraries lack; empty
    /// where they have it. No exception leaves it.
    virtual std::string missingEncoder(FilmKind kind) const = 0;
    /// Begins a film in a file that is there already; what it holds is replaced.
    /// @return an error, a part of a sentence
    virtual Result<std::unique_ptr<FilmWriter>> open(const FilmForm& form,
                                                     const std::filesystem::path& file) const = 0;
};

using GetFilmModule = const FilmModule& (*)();
constexpr const char* GET_FILM_MODULE_NAME = "quarnFilmModule";

} // namespace quarn
