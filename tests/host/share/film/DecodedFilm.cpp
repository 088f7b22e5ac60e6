#include "tests/host/share/film/DecodedFilm.h"

#include "ground/FileBytes.h"

#include <cmath>
#include <memory>
#include <webp/demux.h>

extern "C" {
#include <libavcodec/avcodec.h>
#include <libavformat/avformat.h>
#include <libavutil/pixdesc.h>
#include <libswscale/swscale.h>
}

namespace quarn::test {

namespace {

struct Free {
    void operator()(AVFormatContext* container) const { avformat_close_input(&container); }
    void operator()(AVCodecContext* decoder) const { avcodec_free_context(&decoder); }
    void operator()(AVFrame* frame) const { av_frame_free(&frame); }
    void operator()(AVPacket* packet) const { av_packet_free(&packet); }
    void operator()(SwsContext* scaler) const { sws_freeContext(scaler); }
    void operator()(WebPAnimDecoder* decoder) const { WebPAnimDecoderDelete(decoder); }
};
template <class Thing> using Owned = std::unique_ptr<Thing, Free>;

Image imageOf(const AVFrame& frame) {
    const auto format = static_cast<AVPixelFormat>(frame.format);
    const Owned<SwsContext> scaler(sws_getContext(
        frame.width, frame.height, format, frame.width, frame.height, AV_PIX_FMT_RGBA,
        SWS_BICUBIC | SWS_ACCURATE_RND | SWS_FULL_CHR_H_INT, nullptr, nullptr, nullptr));
    const int* const bt709 = sws_getCoefficients(SWS_CS_ITU709);
    sws_setColorspaceDetails(scaler.get(), bt709, frame.color_range == AVCOL_RANGE_JPEG, bt709, 1,
                             0, 1 << 16, 1 << 16);
    Image image;
    image.resize(frame.width, frame.height);
    std::uint8_t* const rows[] = {image.rgba.data()};
    const int steps[] = {4 * frame.width};
    sws_scale(scaler.get(), frame.data, frame.linesize, 0, frame.height, rows, steps);
    return image;
}

/// Reads the frames of one stream.
class FilmReading {
public:
    explicit FilmReading(DecodedFilm& film) : m_film(film) {}

    bool open(const std::filesystem::path& file) {
        AVFormatContext* container = nullptr;
        if (avformat_open_input(&container, ("file:" + file.native()).c_str(), nullptr, nullptr) !=
            0)
            return false;
        m_container.reset(container);
        if (avformat_find_stream_info(container, nullptr) < 0 || container->nb_streams != 1)
            return false;
        const AVCodecParameters& parameters = *container->streams[0]->codecpar;
        const AVCodec* const codec = avcodec_find_decoder(parameters.codec_id);
        m_decoder.reset(avcodec_alloc_context3(codec));
        m_decoder->pkt_timebase = container->streams[0]->time_base;
        avcodec_parameters_to_context(m_decoder.get(), &parameters);
        m_film.encoding = avcodec_get_name(parameters.codec_id);
        return avcodec_open2(m_decoder.get(), codec, nullptr) == 0;
    }

    bool readAll() {
        while (av_read_frame(m_container.get(), m_packet.get()) == 0) {
            m_end = m_packet->pts + m_packet->duration > m_end ? m_packet->pts + m_packet->duration
                                                               : m_end;
            const bool is_sent = avcodec_send_packet(m_decoder.get(), m_packet.get()) == 0;
            av_packet_unref(m_packet.get());
            if (!is_sent || !takeFrames())
                return false;
        }
        avcodec_send_packet(m_decoder.get(), nullptr);
        takeFrames();
        m_film.seconds = static_cast<double>(m_end) * av_q2d(m_container->streams[0]->time_base);
        return !m_film.frames.empty();
    }

private:
    bool takeFrames() {
        for (;;) {
            const int code = avcodec_receive_frame(m_decoder.get(), m_frame.get());
            if (code < 0)
                return code == AVERROR(EAGAIN) || code == AVERROR_EOF;
            m_film.pixels = av_get_pix_fmt_name(static_cast<AVPixelFormat>(m_frame->format));
            m_film.has_video_colours = m_frame->colorspace == AVCOL_SPC_BT709 &&
                                       m_frame->color_primaries == AVCOL_PRI_BT709 &&
                                       m_frame->color_trc == AVCOL_TRC_BT709 &&
                                       m_frame->color_range == AVCOL_RANGE_MPEG;
            m_film.frames.push_back(imageOf(*m_frame));
        }
    }

    DecodedFilm& m_film;
    Owned<AVFormatContext> m_container;
    Owned<AVCodecContext> m_decoder;
    Owned<AVPacket> m_packet{av_packet_alloc()};
    Owned<AVFrame> m_frame{av_frame_alloc()};
    std::int64_t m_end = 0;
};

/// The decoder above knows no WebP that moves.
void decodeWebp(const std::filesystem::path& file, DecodedFilm& film) {
    const auto bytes = readFileBytes(file, 1U << 30);
    if (!bytes) {
        film.trouble = bytes.message();
        return;
    }
    const WebPData data{bytes.value().bytes().data(), bytes.value().bytes().size()};
    const Owned<WebPAnimDecoder> decoder(WebPAnimDecoderNew(&data, nullptr));
    WebPAnimInfo info{};
    if (!decoder || !WebPAnimDecoderGetInfo(decoder.get(), &info)) {
        film.trouble = "it is no WebP that moves";
        return;
    }
    while (WebPAnimDecoderHasMoreFrames(decoder.get())) {
        std::uint8_t* pixels = nullptr;
        int end_ms = 0;
        if (!WebPAnimDecoderGetNext(decoder.get(), &pixels, &end_ms))
            break;
        Image image;
        image.resize(static_cast<int>(info.canvas_width), static_cast<int>(info.canvas_height));
        std::copy_n(pixels, image.rgba.size(), image.rgba.begin());
        film.frames.push_back(std::move(image));
        film.seconds = end_ms / 1000.0;
    }
}

} // namespace

DecodedFilm decodeFilm(const std::filesystem::path& file) {
    DecodedFilm film;
    av_log_set_level(AV_LOG_QUIET);
    if (file.extension() == ".webp") {
        decodeWebp(file, film);
        return film;
    }
    FilmReading reading(film);
    if (!reading.open(file))
        film.trouble = "it cannot be opened as a film";
    else if (!reading.readAll())
        film.trouble = "its frames cannot be decoded";
    return film;
}

double psnr(const Image& one, const Image& other) {
    if (one.width != other.width || one.height != other.height)
        return 0.0;
    double sum = 0.0;
    for (std::size_t i = 0; i < one.rgba.size(); ++i) {
        const double difference =
            i % 4 == 3 ? 0.0
                       : static_cast<double>(one.rgba[i]) - static_cast<double>(other.rgba[i]);
        sum += difference * difference;
    }
    const double mean = sum / (0.75 * static_cast<double>(one.rgba.size()));
    return mean == 0.0 ? 99.0 : 10.0 * std::log10(255.0 * 255.0 / mean);
}

} // namespace quarn::test
