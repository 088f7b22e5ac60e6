#include "host/share/film/module/FrameStore.h"

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <fcntl.h>
#include <string>
#include <unistd.h>

namespace quarn {

namespace {

constexpr AVCodecID LOSSLESS = AV_CODEC_ID_FFVHUFF; // quick both ways
constexpr const char* CANNOT_KEEP = "its frames cannot be kept beside its file";
constexpr const char* CANNOT_READ = "its frames cannot be read back from beside its file";

Error systemError(const char* what) {
    return {std::string(what) + " (" + std::strerror(errno) + ")"};
}

/// A file without a name where the file system has such; else one whose name is gone at once.
int openHidden(const std::filesystem::path& folder) {
    const int nameless = open(folder.c_str(), O_TMPFILE | O_RDWR | O_CLOEXEC, 0600);
    if (nameless >= 0)
        return nameless;
    std::string name = (folder / ".quarn-XXXXXX").native();
    const int named = mkostemp(name.data(), O_CLOEXEC);
    if (named >= 0)
        unlink(name.c_str());
    return named;
}

} // namespace

Result<FrameStore> FrameStore::make(const std::filesystem::path& folder, int width, int height,
                                    AVPixelFormat pixels) {
    FrameStore store;
    const int descriptor = openHidden(folder);
    if (descriptor < 0)
        return systemError(CANNOT_KEEP);
    store.m_file.reset(fdopen(descriptor, "w+b"));
    store.m_packet.reset(av_packet_alloc());
    if (const auto there = isMade(store.m_packet); !there)
        return there.error();
    if (const auto opened = store.openEncoder(width, height, pixels); !opened)
        return opened.error();
    if (const auto opened = store.openDecoder(); !opened)
        return opened.error();
    return store;
}

Result<void> FrameStore::openEncoder(int width, int height, AVPixelFormat pixels) {
    const AVCodec* const codec = avcodec_find_encoder(LOSSLESS);
    m_encoder.reset(avcodec_alloc_context3(codec));
    if (const auto there = isMade(m_encoder); !there)
        return there;
    m_encoder->width = width;
    m_encoder->height = height;
    m_encoder->pix_fmt = pixels;
    m_encoder->time_base = {1, 1};
    m_encoder->thread_count = 1;
    const int code = avcodec_open2(m_encoder.get(), codec, nullptr);
    return code < 0 ? avError(CANNOT_KEEP, code) : Result<void>();
}

Result<void> FrameStore::openDecoder() {
    const AVCodec* const codec = avcodec_find_decoder(LOSSLESS);
    m_decoder.reset(avcodec_alloc_context3(codec));
    if (const auto there = isMade(m_decoder); !there)
        return there;
    AVCodecParameters* parameters = avcodec_parameters_alloc();
    int code =
        parameters ? avcodec_parameters_from_context(parameters, m_encoder.get()) : AVERROR(ENOMEM);
    if (code >= 0)
        code = avcodec_parameters_to_context(m_decoder.get(), parameters);
    avcodec_parameters_free(&parameters);
    m_decoder->thread_count = 1;
    if (code >= 0)
        code = avcodec_open2(m_decoder.get(), codec, nullptr);
    return code < 0 ? avError(CANNOT_KEEP, code) : Result<void>();
}

Result<void> FrameStore::add(const AVFrame& frame) {
    int code = avcodec_send_frame(m_encoder.get(), &frame);
    if (code >= 0)
        code = avcodec_receive_packet(m_encoder.get(), m_packet.get());
    if (code < 0)
        return avError(CANNOT_KEEP, code);
    ++m_count;
    const auto written = writePacket();
    av_packet_unref(m_packet.get());
    return written;
}

Result<void> FrameStore::writePacket() const {
    const int size = m_packet->size;
    const bool is_written =
        std::fwrite(&size, sizeof size, 1, m_file.get()) == 1 &&
        std::fwrite(m_packet->data, static_cast<std::size_t>(size), 1, m_file.get()) == 1;
    return is_written ? Result<void>() : systemError(CANNOT_KEEP);
}

Result<void> FrameStore::rewind() {
    m_next = 0;
    if (std::fflush(m_file.get()) != 0 || std::fseek(m_file.get(), 0, SEEK_SET) != 0)
        return systemError(CANNOT_KEEP);
    return {};
}

Result<void> FrameStore::readPacket() const {
    int size = 0;
    if (std::fread(&size, sizeof size, 1, m_file.get()) != 1)
        return systemError(CANNOT_READ);
    if (const int code = av_new_packet(m_packet.get(), size); code < 0)
        return avError(CANNOT_READ, code);
    if (std::fread(m_packet->data, static_cast<std::size_t>(size), 1, m_file.get()) != 1)
        return systemError(CANNOT_READ);
    return {};
}

Result<AvPointer<AVFrame>> FrameStore::next() {
    if (m_next == m_count)
        return AvPointer<AVFrame>();
    if (const auto read = readPacket(); !read)
        return read.error();
    AvPointer<AVFrame> frame(av_frame_alloc());
    if (const auto there = isMade(frame); !there)
        return there.error();
    int code = avcodec_send_packet(m_decoder.get(), m_packet.get());
    av_packet_unref(m_packet.get());
    if (code >= 0)
        code = avcodec_receive_frame(m_decoder.get(), frame.get());
    if (code < 0)
        return avError(CANNOT_READ, code);
    frame->pts = m_next++;
    return frame;
}

} // namespace quarn
