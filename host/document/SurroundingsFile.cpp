#include "host/document/SurroundingsFile.h"

#include "ground/PathText.h"
#include "host/document/Document.h"
#include "host/front_end/FrontEnd.h"
#include "import/environment/EnvironmentReading.h"
#include "sdk/qncore/QnLocalize.h"

#include <utility>

namespace quarn {

namespace fs = std::filesystem;

fs::path surroundingsFile(const Document& document, const fs::path& path) {
    std::error_code error;
    if (fs::exists(path, error) || document.file().empty())
        return path;
    const fs::path beside = document.file().parent_path() / path.filename();
    return fs::exists(beside, error) ? beside : path;
}

/// Of a missing file the time and the size are those that no file has.
SurroundingsPicture::FileState SurroundingsPicture::stateOf(const fs::path& file) {
    std::error_code error;
    FileState state{file, fs::last_write_time(file, error), 0};
    state.bytes = fs::file_size(file, error);
    return state;
}

Result<void> SurroundingsPicture::read(const fs::path& file) {
    const FileState now = stateOf(file);
    if (!m_read || *m_read != now) {
        auto reading = readEnvironment(file);
        m_read = now;
        m_is_told = false;
        m_trouble = reading ? std::string() : reading.message();
        m_moved_pixels = reading ? reading.value().moved_pixels : 0;
        m_picture =
            reading ? std::make_shared<const EnvironmentPicture>(std::move(reading.value().picture))
                    : nullptr;
    }
    return m_picture ? Result<void>() : Error{m_trouble};
}

std::shared_ptr<const EnvironmentPicture> SurroundingsPicture::pictureFor(const Document& document,
                                                                          const fs::path& path) {
    const Result<void> is_read = read(surroundingsFile(document, path));
    if (!std::exchange(m_is_told, true))
        tell(document);
    return is_read ? m_picture : nullptr;
}

void SurroundingsPicture::tell(const Document& document) {
    if (!m_picture)
        document.frontEnd().warn(
            (KM_wString::FromUtf8(m_trouble) + L" " +
             QnLocalizeString(L"Until it can be read the light is the automatic one.", 42921))
                .View());
    else if (m_moved_pixels > 0)
        document.frontEnd().warn(
            KM_wString::FormatToString(
                QnLocalizeString(L"Pixels of %s that are no light or brighter than a million were "
                                 L"made black or as bright as that: %d.",
                                 42924),
                textFromPath(m_read->file).Array(), static_cast<int>(m_moved_pixels))
                .View());
}

} // namespace quarn
