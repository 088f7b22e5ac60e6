#include "host/share/viewer/ViewerPage.h"

#include "ground/PathText.h"
#include "host/share/Base64Text.h"
#include "host/share/frames/FramePicture.h"
#include "host/share/viewer/PagePictures.h"
#include "host/share/viewer/PageRecording.h"
#include "host/share/viewer/PageTemplate.h"
#include "host/share/viewer/PageTexts.h"
#include "sdk/qncore/QnLocalize.h"

#include <algorithm>
#include <fstream>
#include <map>

namespace quarn {

namespace {

namespace fs = std::filesystem;

constexpr std::string_view MARK = "<meta name=\"generator\" content=\"Zoetrix viewer\">";
constexpr std::size_t HEAD_BYTES = 1024; // of a page, where its mark stands
/// Of pictures, before they become a third larger as text.
constexpr std::uint64_t MOST_BYTES_INSIDE = 1536ULL << 20;

template <class... Arguments>
std::string sentence(const wchar_t* format, const Arguments&... arguments) {
    return KM_wString::FormatToString(format, arguments...).ToUtf8();
}

/// The same for the same page, and nothing that a name in it could hold.
std::string nonceOf(const std::string& recording) {
    char text[17];
    std::snprintf(text, sizeof text, "%016zx", std::hash<std::string>()(recording));
    return text;
}

class PageMaking {
public:
    PageMaking(const RecordedFolder& recorded, const PageWish& wish, const PageSources& sources,
               const PageProgress& progress)
        : m_folder(recorded.folder), m_manifest(recorded.manifest), m_sources(sources),
          m_progress(progress), m_is_one_file(wish.is_one_file),
          m_title(wish.title.empty() ? recorded.manifest.name : wish.title) {
        m_page.file =
            m_folder / pathFromText(KM_wString::FromUtf8(viewerPageName(m_manifest.name)).View());
    }

    Result<WrittenPage> run() {
        if (const auto allowed = checkPlace(); !allowed)
            return allowed.error();
        leaveOutDamaged();
        if (m_manifest.images.empty())
            return noFrames();
        chooseForm();
        if (const auto fits = checkSize(); !fits)
            return fits.error();
        if (const auto known = findSize(); !known)
            return known.error();
        const auto written = writeFileInPieces(
            m_page.file, [this](const ByteSink& sink) { return fill(sink); },
            m_sources.overwrites ? Protection::overridden : Protection::respected);
        if (!written)
            return written.error();
        finishReport();
        return m_page;
    }

private:
    Result<void> checkPlace() const {
        std::ifstream stream(m_page.file, std::ios::binary);
        if (!stream || m_sources.overwrites)
            return {};
        std::string head(HEAD_BYTES, '\0');
        stream.read(head.data(), HEAD_BYTES);
        if (head.find(MARK) != head.npos)
            return {};
        return Error{sentence(QnLocalizeString(L"%s is no viewer page of this program and is left "
                                               L"alone. Rename it, or let files be replaced.",
                                               42746),
                              textFromPath(m_page.file).Array())};
    }

    void leaveOutDamaged() {
        std::vector<std::string> damaged;
        const std::size_t all = m_manifest.images.size();
        std::erase_if(m_manifest.images, [&](const ManifestFrame& frame) {
            if (isWholePicture(pathOf(frame)))
                return false;
            damaged.push_back(frame.file);
            return true;
        });
        tellDamaged(damaged, all);
    }

    void tellDamaged(const std::vector<std::string>& files, std::size_t all) {
        if (!files.empty())
            m_page.warnings.push_back(sentence(
                QnLocalizeString(
                    L"%d of %d frames are cut off or damaged and are not shown; the first is %s.",
                    42745),
                static_cast<int>(files.size()), static_cast<int>(all),
                KM_wString::FromUtf8(files.front()).Array()));
    }

    Error noFrames() const {
        return {sentence(
            QnLocalizeString(L"No frame in %s can be shown: all are cut off or damaged. Record "
                             L"them again.",
                             42747),
            textFromPath(m_folder).Array())};
    }

    void chooseForm() {
        if (m_is_one_file || isShownByBrowsers(m_manifest.extension))
            return;
        m_is_one_file = true;
        m_page.warnings.push_back(sentence(
            QnLocalizeString(L"Browsers show no %s pictures: the page has them inside, as JPEG.",
                             42744),
            KM_wString::FromUtf8(m_manifest.extension).Array()));
    }

    Result<void> checkSize() const {
        std::uint64_t bytes = 0;
        for (const ManifestFrame& frame : m_manifest.images) {
            std::error_code error;
            const auto size = fs::file_size(pathOf(frame), error);
            bytes += error ? 0 : size;
        }
        const bool is_jpeg = m_manifest.extension == "jpg" || m_manifest.extension == "jpeg";
        if (!m_is_one_file || !is_jpeg || bytes <= MOST_BYTES_INSIDE)
            return {};
        return Error{sentence(
            QnLocalizeString(L"The pictures of %s are too large for one file that browsers open. "
                             L"Make a page beside them, or record fewer or smaller ones.",
                             42748),
            textFromPath(m_folder).Array())};
    }

    /// A recording whose size nobody wrote down has that of its first picture.
    Result<void> findSize() {
        m_width_px = m_manifest.width_px;
        m_height_px = m_manifest.height_px;
        if (m_width_px > 0 && m_height_px > 0)
            return {};
        const auto picture = readFramePicture(pathOf(m_manifest.images.front()));
        if (!picture)
            return picture.error();
        m_width_px = picture.value().width;
        m_height_px = picture.value().height;
        return {};
    }

    Result<void> fill(const ByteSink& sink) {
        const std::string recording =
            pageRecordingJson({m_title, m_is_one_file, m_width_px, m_height_px, m_manifest});
        const auto text = [](const std::string& words) {
            return [words](const ByteSink& to) { put(to, words); };
        };
        const PlaceFillers fillers = {
            {"title", text(htmlText(m_title))},
            {"nonce", text(nonceOf(recording))},
            {"recording", text(jsonInHtml(recording))},
            {"texts", text(jsonInHtml(pageTextsJson(m_sources.locale_folders)))},
            {"first", [this](const ByteSink& to) { putFirst(to); }},
            {"frames", [this](const ByteSink& to) { putFrames(to); }},
        };
        const ByteSink counted = [this, &sink](std::span<const std::byte> bytes) {
            m_page.bytes += bytes.size();
            return !m_is_given_up && sink(bytes);
        };
        const auto filled = fillTemplate(m_sources.viewer_folder / "viewer.html", fillers, counted);
        if (filled && m_is_given_up)
            return Error{"The page " + textFromPath(m_page.file).ToUtf8() +
                         " is not written: it was given up."};
        return filled;
    }

    void putFirst(const ByteSink& sink) {
        const ManifestFrame& first = m_manifest.images.front();
        if (!m_is_one_file) {
            put(sink, addressOf(first.file));
            return;
        }
        put(sink, "data:image/jpeg;base64,");
        putPicture(first, sink);
    }

    /// In the order in which the script wants them, so that a page which is still on its way turns.
    void putFrames(const ByteSink& sink) {
        if (!m_is_one_file)
            return;
        std::map<int, const ManifestFrame*> frames;
        for (const ManifestFrame& frame : m_manifest.images)
            frames[frame.number] = &frame;
        frames.erase(frames.begin()); // it stands in the image element already
        for (const int number : coarseToFine(pageFrames(m_manifest))) {
            const auto frame = frames.find(number);
            if (frame == frames.end())
                continue;
            put(sink, "<script type=\"text/plain\" id=\"frame-" + std::to_string(number) + "\">");
            putPicture(*frame->second, sink);
            if (!put(sink, "</script>\n"))
                return;
        }
    }

    /// Asked before each picture: one that is no JPEG takes a moment.
    bool isStillWanted() {
        if (m_progress && !m_is_given_up) {
            const auto pictures = static_cast<double>(m_manifest.images.size());
            m_is_given_up = !m_progress(m_pictures_begun++ / pictures);
        }
        return !m_is_given_up;
    }

    void putPicture(const ManifestFrame& frame, const ByteSink& sink) {
        if (!isStillWanted())
            return;
        const auto picture = framesJpeg(pathOf(frame));
        if (picture)
            put(sink, base64Text(picture.value()));
        else
            m_unreadable.push_back(frame.file);
    }

    void finishReport() {
        tellDamaged(m_unreadable, m_manifest.images.size());
        m_page.pictures = static_cast<int>(m_manifest.images.size() - m_unreadable.size());
    }

    fs::path pathOf(const ManifestFrame& frame) const { return m_folder / frame.file; }

    fs::path m_folder;
    FramesManifest m_manifest; ///< of the frames that are shown
    const PageSources& m_sources;
    const PageProgress& m_progress;
    int m_pictures_begun = 0;
    bool m_is_given_up = false;
    bool m_is_one_file;
    std::string m_title;
    int m_width_px = 0;
    int m_height_px = 0;
    std::vector<std::string> m_unreadable; ///< files that looked whole
    WrittenPage m_page;
};

} // namespace

std::string viewerPageName(const std::string& animation) {
    return animation + "-viewer.html";
}

Result<WrittenPage> writeViewerPage(const RecordedFolder& recorded, const PageWish& wish,
                                    const PageSources& sources, const PageProgress& progress) {
    return PageMaking(recorded, wish, sources, progress).run();
}

} // namespace quarn
