#include "host/share/film/module/FilterGraph.h"

#include <utility>

extern "C" {
#include <libavfilter/buffersink.h>
#include <libavfilter/buffersrc.h>
#include <libavutil/avstring.h>
}

namespace quarn {

namespace {

constexpr const char* CANNOT_FILTER = "its frames cannot be prepared";

std::string escaped(const std::string& text, const char* special) {
    char* made = nullptr;
    if (av_escape(&made, text.c_str(), special, AV_ESCAPE_MODE_BACKSLASH, 0) < 0)
        return {};
    std::string result = made;
    av_free(made);
    return result;
}

Result<void> sendTo(AVFilterContext* source, AVFrame* frame) {
    const int code = av_buffersrc_add_frame_flags(source, frame, AV_BUFFERSRC_FLAG_PUSH);
    return code < 0 ? avError(CANNOT_FILTER, code) : Result<void>();
}

} // namespace

Result<FilterGraph> FilterGraph::make(const std::string& description) {
    FilterGraph made;
    made.m_graph.reset(avfilter_graph_alloc());
    if (const auto there = isMade(made.m_graph); !there)
        return there.error();
    made.m_graph->nb_threads = 1;
    AVFilterInOut* inputs = nullptr;
    AVFilterInOut* outputs = nullptr;
    int code = avfilter_graph_parse2(made.m_graph.get(), description.c_str(), &inputs, &outputs);
    const AvPointer<AVFilterInOut> free_inputs(inputs);
    const AvPointer<AVFilterInOut> free_outputs(outputs);
    if (code >= 0)
        code = avfilter_graph_config(made.m_graph.get(), nullptr);
    if (code < 0)
        return avError(CANNOT_FILTER, code);
    made.m_source = avfilter_graph_get_filter(made.m_graph.get(), "buffer@in");
    made.m_palette = avfilter_graph_get_filter(made.m_graph.get(), "buffer@palette");
    made.m_end = avfilter_graph_get_filter(made.m_graph.get(), "buffersink@out");
    return made;
}

Result<void> FilterGraph::send(AvPointer<AVFrame> frame) {
    return sendTo(m_source, frame.get());
}

Result<void> FilterGraph::sendPalette(AvPointer<AVFrame> palette) {
    const auto sent = sendTo(m_palette, palette.get());
    return sent ? sendTo(m_palette, nullptr) : sent;
}

Result<AvPointer<AVFrame>> FilterGraph::receive() {
    AvPointer<AVFrame> frame(av_frame_alloc());
    if (const auto there = isMade(frame); !there)
        return there.error();
    const int code = av_buffersink_get_frame(m_end, frame.get());
    if (code == AVERROR(EAGAIN) || code == AVERROR_EOF)
        return AvPointer<AVFrame>();
    if (code < 0)
        return avError(CANNOT_FILTER, code);
    return frame;
}

std::string sourceText(const char* name, int width, int height, const char* format) {
    return std::string("buffer@") + name + "=video_size=" + std::to_string(width) + "x" +
           std::to_string(height) + ":pix_fmt=" + format + ":time_base=1/1:pixel_aspect=1/1";
}

/// Twice: for the list of options, and for the text of all filters.
std::string escapedForFilter(const std::string& text) {
    return escaped(escaped(text, ":"), "[],;");
}

} // namespace quarn
