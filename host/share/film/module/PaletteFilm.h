#pragma once

#include "host/share/film/module/FilmStream.h"
#include "host/share/film/module/FramePreparing.h"
#include "host/share/film/module/FrameStore.h"

#include <atomic>

namespace quarn {

/// A film whose frames share one palette, which is made from all of them: they are kept until the
/// last one is there.
class PaletteFilm final : public FilmWriter {
public:
    static Result<std::unique_ptr<FilmWriter>> open(const FilmForm& form,
                                                    const std::filesystem::path& file);

    Result<void> add(const ImageView& picture, const std::string& caption) override;
    Result<void> finish() override;
    int framesEncoded() const override { return m_encoded; }
    void endSoon() override { m_ends_soon = true; }

private:
    PaletteFilm(const FilmForm& form, FilmStream stream, FrameStore store, FilterGraph counting);
    Result<FilterGraph> quantizer();
    Result<void> writeFrames(FilterGraph& quantizing);
    Result<void> writeFrame(FilterGraph& quantizing, AvPointer<AVFrame> frame);

    FilmForm m_form;
    FramePreparing m_preparing;
    FilmStream m_stream;
    FrameStore m_store;
    FilterGraph m_counting; ///< of colours
    std::atomic<int> m_encoded = 0;
    std::atomic<bool> m_ends_soon = false;
};

} // namespace quarn
