#pragma once

#include "ground/Result.h"

#include <memory>
#include <string>

extern "C" {
#include <libavcodec/avcodec.h>
#include <libavfilter/avfilter.h>
#include <libavformat/avformat.h>
}

namespace quarn {

/// Frees what the libraries made.
struct AvFree {
    void operator()(AVFrame* frame) const { av_frame_free(&frame); }
    void operator()(AVPacket* packet) const { av_packet_free(&packet); }
    void operator()(AVCodecContext* codec) const { avcodec_free_context(&codec); }
    void operator()(AVFilterGraph* graph) const { avfilter_graph_free(&graph); }
    void operator()(AVFilterInOut* ends) const { avfilter_inout_free(&ends); }
};

template <class Thing> using AvPointer = std::unique_ptr<Thing, AvFree>;

/// What a code of the libraries says, as a part of a sentence.
inline Error avError(const std::string& what, int code) {
    char reason[AV_ERROR_MAX_STRING_SIZE] = {};
    av_strerror(code, reason, sizeof reason);
    return {what + " (" + reason + ")"};
}

/// @param pointer  what a library made; null where memory lacked
template <class Pointer> Result<void> isMade(const Pointer& pointer) {
    return pointer ? Result<void>() : Error{"there is not enough memory"};
}

} // namespace quarn
