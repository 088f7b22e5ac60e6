#include "host/share/film/module/FilmStream.h"

namespace quarn {

namespace {

constexpr const char* CANNOT_BEGIN = "its encoder cannot begin";
constexpr const char* CANNOT_ENCODE = "a frame cannot be encoded";
constexpr const char* CANNOT_WRITE = "its file cannot be written";

/// Options as the libraries take them.
class Options {
public:
    explicit Options(const AvOptions& options) {
        for (const auto& [name, value] : options)
            av_dict_set(&m_options, name.c_str(), value.c_str(), 0);
    }
    ~Options() { av_dict_free(&m_options); }
    Options(const Options&) = delete;
    Options& operator=(const Options&) = delete;

    AVDictionary** list() { return &m_options; }

private:
    AVDictionary* m_options = nullptr;
};

void setColours(AVCodecContext& encoder) {
    encoder.colorspace = AVCOL_SPC_BT709;
    encoder.color_primaries = AVCOL_PRI_BT709;
    encoder.color_trc = AVCOL_TRC_BT709;
    encoder.color_range = AVCOL_RANGE_MPEG;
}

} // namespace

void FilmStream::Close::operator()(AVFormatContext* container) const {
    if (container->pb)
        avio_closep(&container->pb);
    avformat_free_context(container);
}

Result<FilmStream> FilmStream::open(const FilmForm& form, const std::filesystem::path& file) {
    FilmStream stream;
    stream.m_packet.reset(av_packet_alloc());
    if (const auto there = isMade(stream.m_packet); !there)
        return there.error();
    AVFormatContext* container = nullptr;
    // The name is never read as one of the library's protocols.
    const std::string url = "file:" + file.native();
    const int code = avformat_alloc_output_context2(&container, nullptr,
                                                    recipeOf(form.kind).container, url.c_str());
    stream.m_container.reset(container);
    if (code < 0)
        return avError(CANNOT_BEGIN, code);
    if (const auto opened = stream.openEncoder(form); !opened)
        return opened.error();
    if (const auto opened = stream.openFile(form, file); !opened)
        return opened.error();
    return stream;
}

Result<void> FilmStream::openEncoder(const FilmForm& form) {
    const FilmRecipe& recipe = recipeOf(form.kind);
    const AVCodec* const codec = avcodec_find_encoder_by_name(recipe.encoder);
    if (codec == nullptr)
        return Error{std::string("there is no encoder ") + recipe.encoder};
    m_encoder.reset(avcodec_alloc_context3(codec));
    if (const auto there = isMade(m_encoder); !there)
        return there;
    m_is_one_packet = recipe.is_one_packet;
    m_encoder->width = form.width;
    m_encoder->height = form.height;
    m_encoder->pix_fmt = recipe.pixels;
    m_encoder->time_base = {1, form.frame_rate};
    m_encoder->framerate = {form.frame_rate, 1};
    m_encoder->sample_aspect_ratio = {1, 1};
    m_encoder->thread_count = form.threads;
    // Whoever drags a player's slider sees a frame soon.
    m_encoder->gop_size = 2 * form.frame_rate;
    if (recipe.has_video_colours)
        setColours(*m_encoder);
    if ((m_container->oformat->flags & AVFMT_GLOBALHEADER) != 0)
        m_encoder->flags |= AV_CODEC_FLAG_GLOBAL_HEADER;
    Options options(encoderOptions(form));
    const int code = avcodec_open2(m_encoder.get(), codec, options.list());
    return code < 0 ? avError(CANNOT_BEGIN, code) : Result<void>();
}

Result<void> FilmStream::openFile(const FilmForm& form, const std::filesystem::path& file) {
    AVStream* const stream = avformat_new_stream(m_container.get(), nullptr);
    if (const auto there = isMade(stream); !there)
        return there;
    stream->time_base = m_encoder->time_base;
    stream->avg_frame_rate = m_encoder->framerate;
    stream->sample_aspect_ratio = m_encoder->sample_aspect_ratio;
    int code = avcodec_parameters_from_context(stream->codecpar, m_encoder.get());
    if (code >= 0)
        code = avio_open(&m_container->pb, ("file:" + file.native()).c_str(), AVIO_FLAG_WRITE);
    Options options(containerOptions(form));
    if (code >= 0)
        code = avformat_write_header(m_container.get(), options.list());
    return code < 0 ? avError(CANNOT_WRITE, code) : Result<void>();
}

Result<void> FilmStream::write(const AVFrame& frame) {
    if (m_is_one_packet)
        ++m_encoded;
    return encode(&frame);
}

Result<void> FilmStream::encode(const AVFrame* frame) {
    int code = avcodec_send_frame(m_encoder.get(), frame);
    while (code >= 0) {
        code = avcodec_receive_packet(m_encoder.get(), m_packet.get());
        if (code == AVERROR(EAGAIN) || code == AVERROR_EOF)
            return {};
        if (code < 0)
            break;
        if (const auto stored = store(*m_packet); !stored)
            return stored;
    }
    return avError(CANNOT_ENCODE, code);
}

/// Where the disk is full the file tells so before the container does.
Result<void> FilmStream::store(AVPacket& packet) {
    if (packet.duration == 0)
        packet.duration = 1; // what the last frame, or the only one, lasts
    if (!m_is_one_packet)
        ++m_encoded;
    packet.stream_index = 0;
    av_packet_rescale_ts(&packet, m_encoder->time_base, m_container->streams[0]->time_base);
    const int code = av_interleaved_write_frame(m_container.get(), &packet);
    if (m_container->pb->error < 0)
        return avError(CANNOT_WRITE, m_container->pb->error);
    return code < 0 ? avError(CANNOT_WRITE, code) : Result<void>();
}

Result<void> FilmStream::finish() {
    if (const auto flushed = encode(nullptr); !flushed)
        return flushed;
    int code = av_write_trailer(m_container.get());
    if (m_container->pb->error < 0)
        code = m_container->pb->error;
    const int closed = avio_closep(&m_container->pb);
    code = code < 0 ? code : closed;
    return code < 0 ? avError(CANNOT_WRITE, code) : Result<void>();
}

} // namespace quarn
