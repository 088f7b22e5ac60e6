#include "host/share/film/module/EncodedFilm.h"

namespace quarn {

Result<void> EncodedFilm::add(const ImageView& picture, const std::string& caption) {
    const auto frame = m_preparing.prepare(picture, caption, m_added);
    if (!frame)
        return frame.error();
    ++m_added;
    const auto written = m_stream.write(*frame.value());
    m_encoded = m_stream.framesEncoded();
    return written;
}

Result<void> EncodedFilm::finish() {
    const auto finished = m_stream.finish();
    m_encoded = m_stream.framesEncoded();
    return finished;
}

} // namespace quarn
