#pragma once

#include "host/share/film/module/AvPointers.h"

#include <cstdio>
#include <filesystem>

namespace quarn {

/// Keeps frames, without loss, in a file that nobody sees, so that they can be gone through twice
/// however many they are.
class FrameStore {
public:
    FrameStore(FrameStore&&) = default;

    /// @param folder  of the file
    static Result<FrameStore> make(const std::filesystem::path& folder, int width, int height,
                                   AVPixelFormat pixels);

    /// Appends a frame.
    Result<void> add(const AVFrame& frame);
    /// No more come: the next one is the first.
    Result<void> rewind();
    /// @return the next frame, with its number as its time; null behind the last one
    Result<AvPointer<AVFrame>> next();
    int count() const { return m_count; }

private:
    struct Close {
        void operator()(std::FILE* file) const { (void)std::fclose(file); }
    };

    FrameStore() = default;
    Result<void> openEncoder(int width, int height, AVPixelFormat pixels);
    Result<void> openDecoder();
    Result<void> writePacket() const;
    Result<void> readPacket() const;

    std::unique_ptr<std::FILE, Close> m_file;
    AvPointer<AVCodecContext> m_encoder;
    AvPointer<AVCodecContext> m_decoder;
    AvPointer<AVPacket> m_packet;
    int m_count = 0;
    int m_next = 0;
};

} // namespace quarn
