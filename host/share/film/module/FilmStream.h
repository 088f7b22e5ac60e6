#pragma once

#include "host/share/film/module/AvPointers.h"
#include "host/share/film/module/FilmRecipe.h"

namespace quarn {

/// Encodes frames and writes them into the file of a film.
class FilmStream {
public:
    FilmStream(FilmStream&&) = default;

    /// @param file  is there; what it holds is replaced
    static Result<FilmStream> open(const FilmForm& form, const std::filesystem::path& file);

    /// @param frame  in the pixels of the recipe; its time is its number
    Result<void> write(const AVFrame& frame);
    /// Writes what the encoder still holds, and the end of the file.
    Result<void> finish();
    /// Frames that are encoded; of those that come out together, that the encoder has.
    int framesEncoded() const { return m_encoded; }

private:
    struct Close {
        void operator()(AVFormatContext* container) const;
    };

    FilmStream() = default;
    Result<void> openEncoder(const FilmForm& form);
    Result<void> openFile(const FilmForm& form, const std::filesystem::path& file);
    Result<void> encode(const AVFrame* frame);
    Result<void> store(AVPacket& packet);

    AvPointer<AVCodecContext> m_encoder;
    std::unique_ptr<AVFormatContext, Close> m_container;
    AvPointer<AVPacket> m_packet;
    bool m_is_one_packet = false;
    int m_encoded = 0;
};

} // namespace quarn
