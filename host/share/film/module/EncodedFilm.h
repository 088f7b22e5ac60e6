#pragma once

#include "host/share/film/module/FilmStream.h"
#include "host/share/film/module/FramePreparing.h"

#include <atomic>

namespace quarn {

/// A film whose frames are encoded as they come.
class EncodedFilm final : public FilmWriter {
public:
    EncodedFilm(const FilmForm& form, FilmStream stream)
        : m_preparing(form), m_stream(std::move(stream)) {}

    Result<void> add(const ImageView& picture, const std::string& caption) override;
    Result<void> finish() override;
    int framesEncoded() const override { return m_encoded; }
    void endSoon() override {}

private:
    FramePreparing m_preparing;
    FilmStream m_stream;
    int m_added = 0;
    std::atomic<int> m_encoded = 0;
};

} // namespace quarn
