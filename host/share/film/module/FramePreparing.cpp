#include "host/share/film/module/FramePreparing.h"

#include "host/share/film/module/FilmRecipe.h"

#include <algorithm>
#include <cstring>

extern "C" {
#include <libavutil/pixdesc.h>
}

namespace quarn {

namespace {

constexpr const char* CAPTION = "caption";
constexpr int BYTES_OF_PIXEL = 4;

/// The side of a picture in the filters: a film may be longer by the one pixel that makes it even.
int filteredSide(int picture, int film) {
    return film == picture + 1 ? film : picture;
}

void copyRow(const ImageView& picture, int row, std::uint8_t* to, int width) {
    const std::size_t bytes = static_cast<std::size_t>(picture.width) * BYTES_OF_PIXEL;
    std::memcpy(to, picture.rgba.data() + static_cast<std::size_t>(row) * bytes, bytes);
    if (width > picture.width)
        std::memcpy(to + bytes, to + bytes - BYTES_OF_PIXEL, BYTES_OF_PIXEL);
}

} // namespace

Result<AvPointer<AVFrame>> FramePreparing::prepare(const ImageView& picture,
                                                   const std::string& caption, int number) {
    if (!m_filters)
        if (const auto begun = begin(picture); !begun)
            return begun.error();
    auto frame = frameOf(picture);
    if (!frame)
        return frame;
    frame.value()->pts = number;
    if (av_dict_set(&frame.value()->metadata, CAPTION, caption.c_str(), 0) < 0)
        return Error{"there is not enough memory"};
    if (const auto sent = m_filters->send(std::move(frame.value())); !sent)
        return sent.error();
    auto prepared = m_filters->receive();
    if (prepared && !prepared.value())
        return Error{"its frames cannot be prepared"};
    return prepared;
}

Result<void> FramePreparing::begin(const ImageView& picture) {
    m_width = filteredSide(picture.width, m_form.width);
    m_height = filteredSide(picture.height, m_form.height);
    auto filters = FilterGraph::make(description());
    if (!filters)
        return filters.error();
    m_filters = std::move(filters.value());
    return {};
}

Result<AvPointer<AVFrame>> FramePreparing::frameOf(const ImageView& picture) const {
    AvPointer<AVFrame> frame(av_frame_alloc());
    if (const auto there = isMade(frame); !there)
        return there.error();
    frame->format = AV_PIX_FMT_RGB0;
    frame->width = m_width;
    frame->height = m_height;
    frame->sample_aspect_ratio = {1, 1};
    if (const int code = av_frame_get_buffer(frame.get(), 0); code < 0)
        return avError("its frames cannot be prepared", code);
    for (int row = 0; row < m_height; ++row)
        copyRow(picture, std::min(row, picture.height - 1),
                frame->data[0] + static_cast<std::ptrdiff_t>(row) * frame->linesize[0], m_width);
    return frame;
}

std::string FramePreparing::description() const {
    const FilmRecipe& recipe = recipeOf(m_form.kind);
    const bool is_scaled = m_form.width != m_width || m_form.height != m_height;
    std::string text =
        sourceText("in", m_width, m_height, "rgb0") + ",scale=" + std::to_string(m_form.width) +
        ":" + std::to_string(m_form.height) + ":flags=" + (is_scaled ? "area" : "bicubic") +
        "+accurate_rnd+full_chroma_inp+full_chroma_int";
    if (recipe.has_video_colours)
        text += ":out_color_matrix=bt709:out_range=tv";
    text += std::string(",format=") + av_get_pix_fmt_name(recipe.prepared);
    return text + captionFilter() + ",buffersink@out";
}

/// White on a dark plate, so that it is read on snow and at night.
std::string FramePreparing::captionFilter() const {
    if (m_form.font.empty())
        return "";
    constexpr int smallest_px = 10;
    const int size_px =
        std::max(smallest_px, std::min(std::max(16, m_form.height / 25), m_form.width / 16));
    const std::string margin = std::to_string(size_px);
    return ",drawtext=fontfile=" + escapedForFilter(m_form.font.native()) +
           ":text=" + escapedForFilter(std::string("%{metadata:") + CAPTION + "}") +
           ":fontsize=" + margin + ":fontcolor=white:x=" + margin + ":y=h-th-" + margin +
           ":box=1:boxcolor=black@0.55:boxborderw=" + std::to_string(size_px / 2);
}

} // namespace quarn
