#include "host/share/film/module/PaletteFilm.h"

namespace quarn {

namespace {

constexpr const char* PIXELS = "bgra";

/// One colour is kept for what stays as it was in the frame before.
std::string countingText(const FilmForm& form) {
    return sourceText("in", form.width, form.height, PIXELS) +
           ",palettegen=stats_mode=full:max_colors=" + std::to_string(paletteColours(form)) +
           ",buffersink@out";
}

/// The pattern stands still where the picture does; errors that are handed on to the next pixels
/// would seem to boil.
std::string quantizingText(const FilmForm& form, const AVFrame& palette) {
    return sourceText("in", form.width, form.height, PIXELS) + "[frames];" +
           sourceText("palette", palette.width, palette.height, PIXELS) +
           "[palette];[frames][palette]paletteuse=dither=bayer:bayer_scale=4,buffersink@out";
}

} // namespace

PaletteFilm::PaletteFilm(const FilmForm& form, FilmStream stream, FrameStore store,
                         FilterGraph counting)
    : m_form(form), m_preparing(form), m_stream(std::move(stream)), m_store(std::move(store)),
      m_counting(std::move(counting)) {}

Result<std::unique_ptr<FilmWriter>> PaletteFilm::open(const FilmForm& form,
                                                      const std::filesystem::path& file) {
    auto stream = FilmStream::open(form, file);
    if (!stream)
        return stream.error();
    auto store =
        FrameStore::make(file.parent_path(), form.width, form.height, recipeOf(form.kind).prepared);
    if (!store)
        return store.error();
    auto counting = FilterGraph::make(countingText(form));
    if (!counting)
        return counting.error();
    return std::unique_ptr<FilmWriter>(new PaletteFilm(
        form, std::move(stream.value()), std::move(store.value()), std::move(counting.value())));
}

Result<void> PaletteFilm::add(const ImageView& picture, const std::string& caption) {
    auto frame = m_preparing.prepare(picture, caption, m_store.count());
    if (!frame)
        return frame.error();
    if (const auto kept = m_store.add(*frame.value()); !kept)
        return kept;
    return m_counting.send(std::move(frame.value()));
}

Result<void> PaletteFilm::finish() {
    auto quantizing = quantizer();
    if (!quantizing)
        return quantizing.error();
    if (const auto rewound = m_store.rewind(); !rewound)
        return rewound;
    if (const auto written = writeFrames(quantizing.value()); !written)
        return written;
    return m_stream.finish();
}

Result<FilterGraph> PaletteFilm::quantizer() {
    if (const auto ended = m_counting.send(nullptr); !ended)
        return ended.error();
    auto palette = m_counting.receive();
    if (!palette)
        return palette.error();
    if (!palette.value())
        return Error{"there are no frames to make its palette of"};
    auto quantizing = FilterGraph::make(quantizingText(m_form, *palette.value()));
    if (!quantizing)
        return quantizing;
    palette.value()->pts = 0;
    if (const auto sent = quantizing.value().sendPalette(std::move(palette.value())); !sent)
        return sent.error();
    return quantizing;
}

Result<void> PaletteFilm::writeFrames(FilterGraph& quantizing) {
    while (!m_ends_soon || m_encoded == 0) {
        auto frame = m_store.next();
        if (!frame)
            return frame.error();
        if (!frame.value())
            return {};
        if (const auto written = writeFrame(quantizing, std::move(frame.value())); !written)
            return written;
        m_encoded = m_stream.framesEncoded();
    }
    return {};
}

Result<void> PaletteFilm::writeFrame(FilterGraph& quantizing, AvPointer<AVFrame> frame) {
    if (const auto sent = quantizing.send(std::move(frame)); !sent)
        return sent;
    for (;;) {
        const auto quantized = quantizing.receive();
        if (!quantized)
            return quantized.error();
        if (!quantized.value())
            return {};
        if (const auto written = m_stream.write(*quantized.value()); !written)
            return written;
    }
}

} // namespace quarn
